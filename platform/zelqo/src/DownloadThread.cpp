#include "DownloadThread.h"

#include <utility>

#include "Loop.h"

namespace zelqo {
namespace {

/// Half a frame. An application that is woken for every picture spends more on waking than on them.
constexpr guint kGatherMs = 8;

}  // namespace

DownloadThread* DownloadThread::instance() {
  static DownloadThread thread;
  return thread._thread ? &thread : nullptr;
}

DownloadThread::DownloadThread()
    : _context(g_main_context_new()), _loop(g_main_loop_new(_context.get(), FALSE)) {
  common::OwnedError error;
  _thread = g_thread_try_new("zelqo-download", run, this, common::Out(error));
  if (!_thread) g_warning("zelqo: nothing can be fetched: %s", error->message);
}

DownloadThread::~DownloadThread() {
  if (!_thread) return;
  runIn(_context.get(), [this] { g_main_loop_quit(_loop.get()); });
  g_thread_join(_thread);
}

void DownloadThread::add(Downloader::Order order) {
  order.report = [this, tell = std::move(order.report)](const Downloader::Report& report) {
    gather([tell, report] { tell(report); });
  };
  runIn(_context.get(), [this, order = std::move(order)] { _downloader->add(order); });
}

void DownloadThread::gather(std::function<void()> report) {
  _reports.push_back(std::move(report));
  if (!_handOver) _handOver = callAfter(kGatherMs, handOverCb, this);
}

gboolean DownloadThread::handOverCb(gpointer data) {
  auto* self = static_cast<DownloadThread*>(data);
  self->_handOver.reset();
  runIn(nullptr, [reports = std::exchange(self->_reports, {})] {
    for (const auto& report : reports) report();
  });
  return G_SOURCE_REMOVE;
}

gpointer DownloadThread::run(gpointer data) {
  auto* self = static_cast<DownloadThread*>(data);
  GMainContext* context = self->_context.get();
  g_main_context_push_thread_default(context);
  {
    Downloader downloader{Downloader::Options()};
    self->_downloader = &downloader;
    g_main_loop_run(self->_loop.get());
  }
  self->_handOver.reset();
  // What was ended still has its last word.
  while (g_main_context_iteration(context, FALSE)) {
  }
  g_main_context_pop_thread_default(context);
  return nullptr;
}

}  // namespace zelqo
