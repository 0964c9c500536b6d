#include "DownloadManager.h"

#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <filesystem>

#include "FilePlacer.h"
#include "PartFile.h"

namespace downloads {
namespace {

constexpr std::size_t kMaxRunning = 3;

bool isDownloadable(const std::string& url) {
  GUri* uri = g_uri_parse(url.c_str(), static_cast<GUriFlags>(SOUP_HTTP_URI_FLAGS), nullptr);
  if (!uri) return false;
  const std::string scheme = g_uri_get_scheme(uri);
  const char* host = g_uri_get_host(uri);
  const bool hasHost = host && *host;
  g_uri_unref(uri);
  return hasHost && (scheme == "http" || scheme == "https");
}

std::uint64_t sizeOnDisk(const std::string& path) {
  struct stat info {};
  return lstat(path.c_str(), &info) == 0 ? static_cast<std::uint64_t>(info.st_size) : 0;
}

// What the service no longer has, nobody will go on with.
bool leavesUsefulPart(Failure failure) {
  return failure != Failure::Gone && failure != Failure::Address;
}

}  // namespace

DownloadManager::DownloadManager(Folders folders, Observer& observer)
    : _folders(std::move(folders)),
      _observer(observer),
      _queue(_folders.queueFile),
      _index(_folders.indexFile),
      _session(soup_session_new_with_options("max-conns-per-host", static_cast<int>(kMaxRunning),
                                             nullptr)) {
  std::error_code ignored;
  std::filesystem::create_directories(_folders.downloads, ignored);
  for (auto& download : _queue.load()) {
    if (download.isPending()) download.received = sizeOnDisk(_partPath(download));
    const auto id = download.id;
    _downloads.emplace(id, std::move(download));
  }
}

DownloadManager::~DownloadManager() = default;

std::string DownloadManager::_partPath(const Download& download) const {
  return PartFile::pathFor(_folders.downloads, download.url);
}

void DownloadManager::setNetwork(Network network) {
  _network = network;
  for (auto& [id, download] : _downloads) {
    const bool mayRun =
        network == Network::Wifi || (network == Network::Other && !download.wifiOnly);
    if (download.state != State::Running || mayRun) continue;
    _running.erase(id);
    download.state = State::Queued;
    _store(download);
  }
  _startWaiting();
}

bool DownloadManager::isHeldBack(const Download& download) const {
  if (download.state != State::Queued) return false;
  return _network == Network::None || (download.wifiOnly && _network != Network::Wifi);
}

Download* DownloadManager::_byUrl(const std::string& url) {
  for (auto& [id, download] : _downloads) {
    if (download.url == url) return &download;
  }
  return nullptr;
}

void DownloadManager::add(std::vector<Download> wanted) {
  for (auto& download : wanted) _addOne(std::move(download));
  _observer.onListChanged();
  _startWaiting();
}

void DownloadManager::_addOne(Download wanted) {
  Download* known = _byUrl(wanted.url);
  if (known && known->isPending()) {
    known->wifiOnly = known->wifiOnly && wanted.wifiOnly;
    _store(*known);
    return;
  }
  if (known) {
    // The newest request stands last, and brings the newest name and size.
    wanted.etag = known->etag;
    _queue.remove(known->id);
    _downloads.erase(known->id);
  }
  wanted.id = 0;
  wanted.state = State::Queued;
  wanted.received = sizeOnDisk(_partPath(wanted));
  if (!_queue.save(wanted)) wanted.id = _downloads.empty() ? 1 : _downloads.rbegin()->first + 1;
  const auto id = wanted.id;
  auto& added = _downloads.emplace(id, std::move(wanted)).first->second;
  if (!isDownloadable(added.url)) _fail(added, Failure::Address);
}

void DownloadManager::_startWaiting() {
  for (auto& [id, download] : _downloads) {
    if (_running.size() >= kMaxRunning) return;
    if (download.state == State::Queued && !isHeldBack(download)) _startOne(download);
  }
}

void DownloadManager::_startOne(Download& download) {
  const auto id = download.id;
  Downloader::Job job;
  job.url = download.url;
  job.partPath = _partPath(download);
  job.etag = download.etag;
  job.size = download.size;
  job.silenceMs = _silenceMs;
  Downloader::Listener listener;
  listener.begun = [this, id](const std::string& etag) { _begun(id, etag); };
  listener.progressed = [this, id](std::uint64_t received) { _progressed(id, received); };
  listener.ended = [this, id](Failure failure) { _ended(id, failure); };
  download.state = State::Running;
  download.failure = Failure::None;
  _store(download);
  auto& running = _running[id];
  running = std::make_unique<Downloader>(_session.get(), std::move(job), std::move(listener));
  _observer.onStarted(download);
  running->start();
}

void DownloadManager::_begun(std::int64_t id, const std::string& etag) {
  Download& download = _downloads.at(id);
  download.etag = etag;
  _store(download);
}

void DownloadManager::_progressed(std::int64_t id, std::uint64_t received) {
  Download& download = _downloads.at(id);
  download.received = received;
  _observer.onChanged(download);
}

void DownloadManager::_ended(std::int64_t id, Failure failure) {
  _running.erase(id);
  Download& download = _downloads.at(id);
  if (failure == Failure::None) {
    _finish(download);
  } else {
    _fail(download, failure);
  }
  _startWaiting();
}

void DownloadManager::_finish(Download& download) {
  const std::string path = placeFile(_partPath(download), _folders.downloads, download.name,
                                     _index.find(download.url).value_or(""));
  if (path.empty()) {
    _fail(download, Failure::Storage);
    return;
  }
  _index.set(download.url, path);
  download.path = path;
  download.received = sizeOnDisk(path);
  download.size = download.received;
  download.etag.clear();
  download.state = State::Done;
  _store(download);
  _observer.onDone(download);
}

void DownloadManager::_fail(Download& download, Failure failure) {
  if (!leavesUsefulPart(failure) || sizeOnDisk(_partPath(download)) == 0) {
    unlink(_partPath(download).c_str());
    download.etag.clear();
  }
  download.received = sizeOnDisk(_partPath(download));
  download.state = State::Failed;
  download.failure = failure;
  _store(download);
  _observer.onFailed(download);
}

void DownloadManager::cancel(std::int64_t id) {
  const auto found = _downloads.find(id);
  if (found == _downloads.end() || !found->second.isPending()) return;
  Download& download = found->second;
  _running.erase(id);
  unlink(_partPath(download).c_str());
  download.etag.clear();
  download.received = 0;
  download.state = State::Cancelled;
  _store(download);
  _observer.onCancelled(download);
  _startWaiting();
}

void DownloadManager::retry(std::int64_t id) {
  const auto found = _downloads.find(id);
  if (found == _downloads.end() || found->second.isPending()) return;
  Download& download = found->second;
  if (!isDownloadable(download.url)) return;
  download.state = State::Queued;
  download.failure = Failure::None;
  download.received = sizeOnDisk(_partPath(download));
  _store(download);
  _startWaiting();
}

void DownloadManager::forgetEnded() {
  for (auto entry = _downloads.begin(); entry != _downloads.end();) {
    if (entry->second.isPending()) {
      ++entry;
      continue;
    }
    unlink(_partPath(entry->second).c_str());
    _queue.remove(entry->first);
    entry = _downloads.erase(entry);
  }
  _observer.onListChanged();
}

void DownloadManager::_store(Download& download) {
  _queue.save(download);
  _observer.onChanged(download);
}

std::vector<const Download*> DownloadManager::list() const {
  std::vector<const Download*> all;
  for (const auto& [id, download] : _downloads) all.push_back(&download);
  return all;
}

const Download* DownloadManager::find(std::int64_t id) const {
  const auto found = _downloads.find(id);
  return found == _downloads.end() ? nullptr : &found->second;
}

bool DownloadManager::hasPending() const {
  return std::any_of(_downloads.begin(), _downloads.end(),
                     [](const auto& entry) { return entry.second.isPending(); });
}

}  // namespace downloads
