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

struct Kept {
  int error = ZELQO_ERROR_NONE;
  std::string path;
  std::string reason;
};

Kept keep(PictureFile& file, const HttpFetch::Outcome& outcome) {
  if (outcome.error != ZELQO_ERROR_NONE) return {outcome.error, {}, outcome.reason};
  switch (file.finish()) {
    case PictureFile::Result::Whole:
      return {ZELQO_ERROR_NONE, file.path(), {}};
    case PictureFile::Result::NoPicture:
      return {ZELQO_ERROR_REFUSED, {}, "not a picture"};
    case PictureFile::Result::Failed:
      break;
  }
  return {ZELQO_ERROR_STORE, {}, "it cannot be kept"};
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
  SourceOwner timer = nullptr;
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

Downloader::~Downloader() = default;

void Downloader::add(Order order) {
  if (_cleaned.insert(order.folder).second) PictureFile::removeLeftovers(order.folder);
  const std::size_t count = order.urls.size();
  auto batch = std::make_shared<Batch>(Batch{++_lastRequest, std::move(order), count});
  for (std::size_t i = 0; i < count; i++) _waiting.push_back(Job{batch, i});
  schedulePump();
}

void Downloader::schedulePump() {
  if (!_pump) _pump = callSoon(pumpCb, this);
}

gboolean Downloader::pumpCb(gpointer self) {
  auto* downloader = static_cast<Downloader*>(self);
  downloader->_pump.reset();
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
    report(job, ZELQO_ERROR_INVALID_PARAMETER);
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
  const Kept kept = keep(*transfer.file, outcome);
  Job job = std::move(transfer.job);
  // Whoever is told finds nothing left of what is not whole.
  _active.remove_if([&transfer](const Transfer& other) { return &other == &transfer; });
  schedulePump();
  if (outcome.transient() && job.attempts < _options.retries) {
    retryLater(std::move(job));
    return;
  }
  if (kept.error != ZELQO_ERROR_NONE) {
    g_warning("zelqo: %s was not fetched: %s", nameInLog(job.url()).c_str(), kept.reason.c_str());
  }
  report(job, kept.error, kept.path);
}

void Downloader::retryLater(Job job) {
  const guint pause = _options.firstPauseMs << job.attempts;
  Job& pausing = _pausing.emplace_back(std::move(job));
  pausing.attempts++;
  pausing.owner = this;
  pausing.timer = callAfter(pause, retryCb, &pausing);
}

gboolean Downloader::retryCb(gpointer data) {
  auto* job = static_cast<Job*>(data);
  job->timer.reset();
  Downloader* downloader = job->owner;
  downloader->_waiting.push_back(std::move(*job));
  downloader->_pausing.remove_if([job](const Job& other) { return &other == job; });
  downloader->schedulePump();
  return G_SOURCE_REMOVE;
}

// Last in whatever calls it: who is told may order more.
void Downloader::report(const Job& job, int error, const std::string& path) {
  Batch& batch = *job.batch;
  batch.remaining--;
  batch.order.report(
      {batch.requestId, error, path, job.url(), static_cast<unsigned int>(batch.remaining)});
}

}  // namespace zelqo
