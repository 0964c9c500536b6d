#include "Downloader.h"

#include <algorithm>
#include <utility>

#include "PictureFile.h"

namespace zelqo {
namespace {

constexpr std::size_t kMaxAddress = 2048;

// Addresses let their holder in, so the log does not get them whole.
std::string nameInLog(const std::string& url) {
  constexpr std::size_t shown = 24;
  const common::OwnedText text(
      g_utf8_make_valid(url.c_str(), static_cast<gssize>(std::min(url.size(), shown))));
  const common::OwnedText escaped(g_strescape(text.get(), nullptr));
  return std::string(escaped.get()) + (url.size() > shown ? "…" : "");
}

}  // namespace

struct Downloader::Batch {
  unsigned int requestId;
  Order order;
  std::size_t remaining;
};

struct Downloader::Job {
  std::shared_ptr<Batch> batch;
  std::size_t index;
  int attempts = 0;
  guint timer = 0;
  Downloader* owner = nullptr;

  const std::string& url() const { return batch->order.urls[index]; }
};

struct Downloader::Transfer {
  Job job;
  std::unique_ptr<PictureFile> file;
  std::unique_ptr<HttpFetch> fetch;
};

Downloader::Downloader(const Options& options)
    : _options(options), _session(makeSession(options.connections, options.inactivityS)) {}

Downloader::~Downloader() {
  if (_pump) g_source_remove(_pump);
  for (const Job& job : _pausing) g_source_remove(job.timer);
}

Downloader& Downloader::instance() {
  static Downloader downloader{Options()};
  return downloader;
}

void Downloader::add(Order order) {
  if (_cleaned.insert(order.folder).second) PictureFile::removeLeftovers(order.folder);
  const std::size_t count = order.urls.size();
  auto batch = std::make_shared<Batch>(Batch{++_lastRequest, std::move(order), count});
  for (std::size_t i = 0; i < count; i++) _waiting.push_back(Job{batch, i});
  schedulePump();
}

void Downloader::schedulePump() {
  if (!_pump) _pump = g_idle_add_full(G_PRIORITY_DEFAULT, pumpCb, this, nullptr);
}

gboolean Downloader::pumpCb(gpointer self) {
  auto* downloader = static_cast<Downloader*>(self);
  downloader->_pump = 0;
  downloader->pump();
  return G_SOURCE_REMOVE;
}

void Downloader::pump() {
  while (!_waiting.empty() && _active.size() < static_cast<std::size_t>(_options.connections)) {
    Job job = std::move(_waiting.front());
    _waiting.pop_front();
    start(std::move(job));
  }
}

void Downloader::start(Job job) {
  MessageOwner message =
      job.url().size() <= kMaxAddress ? makeMessage(SOUP_METHOD_GET, job.url()) : nullptr;
  if (!message) {
    g_warning("zelqo: not an address to fetch from: %s", nameInLog(job.url()).c_str());
    report(job, ZELQO_ERROR_INVALID_PARAMETER, nullptr);
    return;
  }
  Transfer& transfer = _active.emplace_back();
  transfer.file = std::make_unique<PictureFile>(job.batch->order.folder, job.url());
  transfer.job = std::move(job);
  transfer.fetch = std::make_unique<HttpFetch>(
      _session.get(), std::move(message), _options.limits,
      [file = transfer.file.get()](guint status, const char* data, gsize size) {
        return status != SOUP_STATUS_OK || file->write(data, size);
      },
      [this, &transfer](const HttpFetch::Outcome& outcome) { transferred(transfer, outcome); });
}

void Downloader::transferred(Transfer& transfer, const HttpFetch::Outcome& outcome) {
  Job job = std::move(transfer.job);
  const std::unique_ptr<PictureFile> file = std::move(transfer.file);
  _active.remove_if([&transfer](const Transfer& other) { return &other == &transfer; });
  schedulePump();

  int error = outcome.error;
  std::string reason = outcome.reason;
  if (error == ZELQO_ERROR_NONE) {
    switch (file->finish()) {
      case PictureFile::Result::Whole:
        report(job, ZELQO_ERROR_NONE, file->path().c_str());
        return;
      case PictureFile::Result::NoPicture:
        error = ZELQO_ERROR_REFUSED;
        reason = "not a picture";
        break;
      case PictureFile::Result::Failed:
        error = ZELQO_ERROR_STORE;
        break;
    }
  }
  if (outcome.transient() && job.attempts < _options.retries) {
    retryLater(std::move(job));
    return;
  }
  g_warning("zelqo: %s was not fetched: %s", nameInLog(job.url()).c_str(), reason.c_str());
  report(job, error, nullptr);
}

void Downloader::retryLater(Job job) {
  const guint pause = _options.firstPauseMs << job.attempts;
  Job& pausing = _pausing.emplace_back(std::move(job));
  pausing.attempts++;
  pausing.owner = this;
  pausing.timer = g_timeout_add(pause, retryCb, &pausing);
}

gboolean Downloader::retryCb(gpointer data) {
  auto* job = static_cast<Job*>(data);
  Downloader* downloader = job->owner;
  downloader->_waiting.push_back(std::move(*job));
  downloader->_pausing.remove_if([job](const Job& other) { return &other == job; });
  downloader->schedulePump();
  return G_SOURCE_REMOVE;
}

// Last in whatever calls it: the callback may order more.
void Downloader::report(const Job& job, int error, const char* path) {
  Batch& batch = *job.batch;
  batch.remaining--;
  batch.order.callback(batch.requestId, error, path, job.url().c_str(),
                       static_cast<unsigned int>(batch.remaining), batch.order.userData);
}

}  // namespace zelqo
