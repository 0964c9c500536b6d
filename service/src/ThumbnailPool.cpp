#include "ThumbnailPool.h"

#include <algorithm>

#include "ThumbnailProcess.h"

namespace service {
namespace {

// Each may need the memory of one picture of the largest permitted size.
constexpr guint kMostThreads = 4;

}  // namespace

ThumbnailPool::ThumbnailPool(std::string program)
    : _program(std::move(program)),
      _threads(g_thread_pool_new(
          runCb, this, static_cast<gint>(std::clamp(g_get_num_processors(), 1U, kMostThreads)),
          FALSE, nullptr)) {}

ThumbnailPool::~ThumbnailPool() {
  g_cancellable_cancel(_cancellable.get());
  // The threads run through the remaining queue without work.
  g_thread_pool_free(_threads, FALSE, TRUE);
}

void ThumbnailPool::add(ThumbnailJob job, std::function<void()> done) {
  g_thread_pool_push(_threads, new Work{std::move(job), std::move(done), _alive}, nullptr);
}

void ThumbnailPool::runCb(gpointer work, gpointer self) {
  static_cast<ThumbnailPool*>(self)->run(static_cast<Work*>(work)->job);
  g_main_context_invoke(nullptr, doneCb, work);
}

gboolean ThumbnailPool::doneCb(gpointer data) {
  const std::unique_ptr<Work> work(static_cast<Work*>(data));
  if (!work->alive.expired()) work->done();
  return G_SOURCE_REMOVE;
}

void ThumbnailPool::run(const ThumbnailJob& job) {
  if (g_cancellable_is_cancelled(_cancellable.get())) return;
  std::unique_ptr<ThumbnailProcess> process = take();
  process->run(job, _cancellable.get());
  giveBack(std::move(process));
}

std::unique_ptr<ThumbnailProcess> ThumbnailPool::take() {
  const std::lock_guard<std::mutex> lock(_mutex);
  if (_idle.empty()) return std::make_unique<ThumbnailProcess>(_program);
  std::unique_ptr<ThumbnailProcess> process = std::move(_idle.back());
  _idle.pop_back();
  return process;
}

void ThumbnailPool::giveBack(std::unique_ptr<ThumbnailProcess> process) {
  const std::lock_guard<std::mutex> lock(_mutex);
  _idle.push_back(std::move(process));
}

}  // namespace service
