#pragma once

#include <libsoup/soup.h>

#include <map>
#include <memory>
#include <string>
#include <vector>

#include <common/Owned.h>
#include "Download.h"
#include "DownloadQueue.h"
#include "Downloader.h"
#include "SharedIndex.h"

namespace downloads {

enum class Network { None, Wifi, Other };

/// Downloads what it is asked for, a few at a time, and keeps the list of it.
class DownloadManager {
 public:
  struct Folders {
    std::string downloads;  ///< where the files go
    std::string queueFile;  ///< database of the list
    std::string indexFile;  ///< JSON file for other applications
  };

  /// Called on the main loop. The download is valid during the call.
  class Observer {
   public:
    virtual ~Observer() = default;
    virtual void onStarted(const Download& download) = 0;
    /// The file lies under its final name and in the index.
    virtual void onDone(const Download& download) = 0;
    virtual void onFailed(const Download& download) = 0;
    virtual void onCancelled(const Download& download) = 0;
    /// Progress or state of one download.
    virtual void onChanged(const Download& download) = 0;
    /// Downloads came or went.
    virtual void onListChanged() = 0;
  };

  DownloadManager(Folders folders, Observer& observer);
  ~DownloadManager();
  DownloadManager(const DownloadManager&) = delete;
  DownloadManager& operator=(const DownloadManager&) = delete;

  /// Longest wait for the next bytes of one file.
  void setSilence(unsigned int milliseconds) { _silenceMs = milliseconds; }

  /// Starts or holds back downloads as the network allows. Nothing runs before the first call.
  void setNetwork(Network network);

  /// An address that is on the list already is downloaded again, or left running.
  void add(std::vector<Download> wanted);
  void cancel(std::int64_t id);
  void retry(std::int64_t id);
  /// Takes everything off the list that neither runs nor waits. Files stay.
  void forgetEnded();

  /// In the order in which they were asked for. The pointers are valid until the list changes.
  std::vector<const Download*> list() const;
  const Download* find(std::int64_t id) const;
  /// Queued, and the network it needs is not there.
  bool isHeldBack(const Download& download) const;
  bool hasPending() const;

 private:
  Download* _byUrl(const std::string& url);
  void _addOne(Download wanted);
  void _startWaiting();
  void _startOne(Download& download);
  void _begun(std::int64_t id, const std::string& etag);
  void _progressed(std::int64_t id, std::uint64_t received);
  void _ended(std::int64_t id, Failure failure);
  void _finish(Download& download);
  void _fail(Download& download, Failure failure);
  void _store(Download& download);
  std::string _partPath(const Download& download) const;

  Folders _folders;
  Observer& _observer;
  DownloadQueue _queue;
  SharedIndex _index;
  common::OwnedObject<SoupSession> _session;
  unsigned int _silenceMs = 60000;
  Network _network = Network::None;
  std::map<std::int64_t, Download> _downloads;
  std::map<std::int64_t, std::unique_ptr<Downloader>> _running;
};

}  // namespace downloads
