#include "Downloader.h"

#include <algorithm>
#include <utility>

#include "PictureFile.h"

namespace zelqo {
namespace {

constexpr std::size_t kMaxAddress = 2048;
/// Where the disk is slower than the service, so many pictures wait in memory for each connection.
constexpr int kUnsavedPerConnection = 1;

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
  std::string content;
  std::unique_ptr<HttpFetch> fetch;  ///< none while the content is saved
};

/// What the thread gets, and gives back.
struct Downloader::Saving {
  std::shared_ptr<Downloader*> owner;
  Transfer* transfer;  ///< there as long as the owner is
  std::string folder;
  std::string url;
  std::string content;
  PictureSaved result = PictureSaved::Failed;
  std::string path;
};

Downloader::Downloader(const Options& options)
    : _options(options),
      _session(makeSession(options.connections, options.inactivityS)),
      _self(std::make_shared<Downloader*>(this)) {}

Downloader::~Downloader() {
  *_self = nullptr;
  if (_pump) g_source_remove(_pump);
  for (const Job& job : _pausing) g_source_remove(job.timer);
}

Downloader& Downloader::instance() {
  static Downloader downloader{Options()};
  return downloader;
}

void Downloader::add(Order order) {
  if (_cleaned.insert(order.folder).second) removePictureLeftovers(order.folder);
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
  const int most = _options.connections * (1 + kUnsavedPerConnection);
  while (!_waiting.empty() && _fetching < _options.connections &&
         _active.size() < static_cast<std::size_t>(most)) {
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
  transfer.job = std::move(job);
  _fetching++;
  transfer.fetch = std::make_unique<HttpFetch>(
      _session.get(), std::move(message), _options.limits,
      [&transfer](guint status, const char* data, gsize size) {
        if (status == SOUP_STATUS_OK) transfer.content.append(data, size);
        return true;
      },
      [this, &transfer](const HttpFetch::Outcome& outcome) { transferred(transfer, outcome); });
}

void Downloader::transferred(Transfer& transfer, const HttpFetch::Outcome& outcome) {
  _fetching--;
  schedulePump();
  if (outcome.error == ZELQO_ERROR_NONE) {
    save(transfer);
    return;
  }
  Job job = take(transfer);
  if (outcome.transient() && job.attempts < _options.retries) {
    retryLater(std::move(job));
  } else {
    failed(job, outcome.error, outcome.reason);
  }
}

/// A disk may take its time, and the main thread has a page to show.
void Downloader::save(Transfer& transfer) {
  auto saving = std::make_unique<Saving>();
  saving->owner = _self;
  saving->transfer = &transfer;
  saving->folder = transfer.job.batch->order.folder;
  saving->url = transfer.job.url();
  saving->content = std::move(transfer.content);
  transfer.fetch.reset();
  const common::OwnedObject<GTask> task(g_task_new(nullptr, nullptr, savedCb, nullptr));
  g_task_set_task_data(task.get(), saving.release(),
                       [](gpointer data) { delete static_cast<Saving*>(data); });
  g_task_run_in_thread(task.get(), saveInThread);
}

void Downloader::saveInThread(GTask* task, gpointer, gpointer data, GCancellable*) {
  auto* saving = static_cast<Saving*>(data);
  saving->result = savePicture(saving->folder, saving->url, saving->content, saving->path);
  g_task_return_boolean(task, TRUE);
}

void Downloader::savedCb(GObject*, GAsyncResult* result, gpointer) {
  const auto* saving = static_cast<const Saving*>(g_task_get_task_data(G_TASK(result)));
  Downloader* downloader = *saving->owner;
  if (downloader) downloader->saved(*saving->transfer, *saving);
}

void Downloader::saved(Transfer& transfer, const Saving& saving) {
  const Job job = take(transfer);
  schedulePump();
  switch (saving.result) {
    case PictureSaved::Whole:
      report(job, ZELQO_ERROR_NONE, saving.path.c_str());
      break;
    case PictureSaved::NoPicture:
      failed(job, ZELQO_ERROR_REFUSED, "not a picture");
      break;
    case PictureSaved::Failed:
      failed(job, ZELQO_ERROR_STORE, "it cannot be kept");
      break;
  }
}

Downloader::Job Downloader::take(Transfer& transfer) {
  Job job = std::move(transfer.job);
  _active.remove_if([&transfer](const Transfer& other) { return &other == &transfer; });
  return job;
}

void Downloader::failed(const Job& job, int error, const std::string& reason) {
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
