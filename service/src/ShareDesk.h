/// The life of a share: from draft over its pictures to publication, recall and expiry.
#pragma once

#include <functional>
#include <map>
#include <string>

#include "BlobStore.h"
#include "Catalog.h"
#include "PushHub.h"
#include "ThumbnailPool.h"

namespace service {

class ShareDesk {
 public:
  ShareDesk(Catalog& catalog, BlobStore& blobs, PushHub& hub, std::string thumbnailProgram);
  ~ShareDesk();
  ShareDesk(const ShareDesk&) = delete;
  ShareDesk& operator=(const ShareDesk&) = delete;

  /// Goes on with what an earlier run left: pictures to be made, shares to expire.
  void resume();

  /// A file has been uploaded: its pictures are made in the background.
  void fileArrived(std::int64_t id, std::int64_t index, const ShareFile& file);
  /// Null, or what is missing.
  const char* complete(const Share& share);
  /// From now on nobody gets anything of it. Asking again changes nothing.
  bool recall(const Share& share);
  /// Called after a share has been published.
  void setPublishedListener(std::function<void(std::int64_t id)> listener);

 private:
  void picturesMade(std::int64_t id);
  void publishWhenReady(std::int64_t id);
  void publish(const Share& share);
  void expireOverdue();
  void scheduleExpiry();
  static gboolean expiryCb(gpointer self);

  Catalog& _catalog;
  BlobStore& _blobs;
  PushHub& _hub;
  std::map<std::int64_t, int> _pending;  ///< pictures in the making, by share
  std::function<void(std::int64_t)> _published;
  guint _expiryTimer = 0;
  ThumbnailPool _thumbnails;
};

}  // namespace service
