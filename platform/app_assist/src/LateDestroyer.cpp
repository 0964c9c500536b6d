#include "LateDestroyer.h"

#include <utility>

#include "app_assist/WViewController.h"

namespace app_assist {

LateDestroyer& LateDestroyer::instance() {
  static LateDestroyer destroyer;
  return destroyer;
}

void LateDestroyer::add(std::unique_ptr<WViewController> controller) {
  _waiting.push_back(std::move(controller));
  if (!_job) _job = ecore_job_add(jobCb, this);
}

/// Ending one may add others: the popups of a page.
void LateDestroyer::flush() {
  while (!_waiting.empty()) {
    const std::unique_ptr<WViewController> controller = std::move(_waiting.front());
    _waiting.erase(_waiting.begin());
    controller->destroy();
  }
  if (_job) ecore_job_del(std::exchange(_job, nullptr));
}

void LateDestroyer::jobCb(void* data) {
  auto* self = static_cast<LateDestroyer*>(data);
  self->_job = nullptr;
  self->flush();
}

}  // namespace app_assist
