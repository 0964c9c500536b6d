#pragma once

#include <libsoup/soup.h>

#include <cstdint>
#include <functional>
#include <memory>
#include <string>

#include <common/Owned.h>
#include "Download.h"

namespace downloads {

class PartFile;

/// One transfer over HTTP into a part file: goes on where the part ends as long as the service
/// still has the same file. Runs on the default main context; destroying it cancels.
class Downloader {
 public:
  struct Job {
    std::string url;
    std::string partPath;
    std::string etag;                ///< of the bytes already in the part, empty when unknown
    std::uint64_t size = 0;          ///< as announced, 0 when unknown
    unsigned int silenceMs = 60000;  ///< longest wait for the next bytes
  };

  /// Calls of `ended` come last and may destroy the downloader; the others must not.
  struct Listener {
    std::function<void(const std::string& etag)> begun;
    std::function<void(std::uint64_t received)> progressed;
    std::function<void(Failure failure)> ended;  ///< None: the part is whole
  };

  Downloader(SoupSession* session, Job job, Listener listener);
  ~Downloader();
  Downloader(const Downloader&) = delete;
  Downloader& operator=(const Downloader&) = delete;

  /// `ended` is never called from inside.
  void start();

 private:
  // What a callback holds instead of the downloader, which may be gone when it comes.
  using Link = std::weak_ptr<Downloader*>;

  static void _answeredCb(GObject* session, GAsyncResult* result, gpointer data);
  static void _readCb(GObject* stream, GAsyncResult* result, gpointer data);
  static gboolean _silenceCb(gpointer data);
  static gboolean _endCb(gpointer data);

  Failure _prepare();
  void _request();
  void _answered(GInputStream* stream, GError* error);
  Failure _accept(unsigned int status);
  Failure _acceptRest();
  Failure _acceptWhole();
  Failure _checkLength(std::uint64_t remaining);
  void _readMore();
  void _received(GBytes* bytes, GError* error);
  void _watchSilence();
  void _endLater(Failure failure);
  void _end(Failure failure);

  common::OwnedObject<SoupSession> _session;
  Job _job;
  Listener _listener;
  std::unique_ptr<PartFile> _part;
  common::OwnedObject<GCancellable> _cancellable;
  common::OwnedObject<SoupMessage> _message;
  common::OwnedObject<GInputStream> _stream;
  std::uint64_t _total = 0;
  bool _triedWithoutRange = false;
  Failure _outcome = Failure::None;
  std::shared_ptr<Downloader*> _self;  // null from the end on
  guint _silenceSource = 0;
  guint _endSource = 0;
};

}  // namespace downloads
