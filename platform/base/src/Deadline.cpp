#include <base/Deadline.h>

namespace base {

Deadline::Deadline(std::chrono::milliseconds time)
    : _cancellable(g_cancellable_new()), _watch([this, time] {
        std::unique_lock<std::mutex> lock(_mutex);
        if (!_done.wait_for(lock, time, [this] { return _isDone; })) {
          g_cancellable_cancel(_cancellable.get());
        }
      }) {}

Deadline::~Deadline() {
  {
    const std::lock_guard<std::mutex> lock(_mutex);
    _isDone = true;
  }
  _done.notify_all();
  _watch.join();
}

}  // namespace base
