#include "ShareDesk.h"

#include <algorithm>

#include "Address.h"
#include "ManifestWriter.h"

namespace service {
namespace {

constexpr std::int64_t kLongestWaitMs = std::int64_t{3600} * 1000;
// How long a phone that was switched off can still learn what became of a share.
constexpr std::int64_t kRememberMs = std::int64_t{100} * 24 * 3600 * 1000;

bool isVideo(const ShareFile& file) {
  return file.type && file.type->rfind("video/", 0) == 0;
}
bool isImage(const ShareFile& file) {
  return file.type && file.type->rfind("image/", 0) == 0;
}

}  // namespace

ShareDesk::ShareDesk(Catalog& catalog, BlobStore& blobs, PushHub& hub, std::string thumbnailProgram)
    : _catalog(catalog), _blobs(blobs), _hub(hub), _thumbnails(std::move(thumbnailProgram)) {}

ShareDesk::~ShareDesk() {
  if (_expiryTimer) g_source_remove(_expiryTimer);
}

void ShareDesk::setPublishedListener(std::function<void(std::int64_t)> listener) {
  _published = std::move(listener);
}

void ShareDesk::resume() {
  for (const Share& share : _catalog.purge(nowMs() - kRememberMs)) {
    _blobs.withdraw(share.id, share.token);
  }
  for (const Share& share : _catalog.sharesIn(ShareState::Preparing)) {
    const std::vector<ShareFile> files = _catalog.files(share.id);
    for (std::size_t i = 0; i < files.size(); i++) {
      fileArrived(share.id, static_cast<std::int64_t>(i), files[i]);
    }
    publishWhenReady(share.id);
  }
  expireOverdue();
}

void ShareDesk::fileArrived(std::int64_t id, std::int64_t index, const ShareFile& file) {
  if (!isImage(file) && !isVideo(file)) return;
  if (_blobs.stagedSize(id, BlobKind::File, index).value_or(0) == 0) return;
  _pending[id]++;
  ThumbnailJob job{isVideo(file), _blobs.staged(id, BlobKind::File, index),
                   _blobs.staged(id, BlobKind::Thumb, index),
                   _blobs.staged(id, BlobKind::Mid, index),
                   _blobs.staged(id, BlobKind::Big, index)};
  _thumbnails.add(std::move(job), [this, id] { picturesMade(id); });
}

void ShareDesk::picturesMade(std::int64_t id) {
  if (--_pending[id] == 0) _pending.erase(id);
  publishWhenReady(id);
}

const char* ShareDesk::complete(const Share& share) {
  if (share.state != ShareState::Draft) return nullptr;
  if (!share.lenient) {
    const std::vector<ShareFile> files = _catalog.files(share.id);
    for (std::size_t i = 0; i < files.size(); i++) {
      if (_blobs.stagedSize(share.id, BlobKind::File, static_cast<std::int64_t>(i)) !=
          files[i].size) {
        return "a file is missing";
      }
    }
  }
  if (!_catalog.prepare(share.id, nowMs() + share.lifetimeS * 1000)) return "storage failed";
  publishWhenReady(share.id);
  return nullptr;
}

void ShareDesk::publishWhenReady(std::int64_t id) {
  if (_pending.count(id)) return;
  const auto share = _catalog.share(id);
  if (share && share->state == ShareState::Preparing) publish(*share);
}

void ShareDesk::publish(const Share& share) {
  const std::string manifest = writeManifest(share, _catalog.files(share.id), _blobs);
  if (!_blobs.publish(share.id, share.token, manifest) || !_catalog.publish(share.id, manifest)) {
    return;
  }
  for (const std::string& msisdn : _catalog.recipients(share.id)) _hub.wake(msisdn);
  if (_published) _published(share.id);
  expireOverdue();
}

bool ShareDesk::recall(const Share& share) {
  if (share.closed()) return true;
  if (!_catalog.recall(share.id)) return false;
  _blobs.withdraw(share.id, share.token);
  for (const std::string& msisdn : _catalog.recipients(share.id)) _hub.wake(msisdn);
  _hub.wake(share.sender);
  return true;
}

void ShareDesk::expireOverdue() {
  for (const Share& share : _catalog.overdue(nowMs())) {
    if (_catalog.expire(share.id)) _blobs.withdraw(share.id, share.token);
  }
  scheduleExpiry();
}

void ShareDesk::scheduleExpiry() {
  if (_expiryTimer) g_source_remove(std::exchange(_expiryTimer, 0));
  const auto next = _catalog.nextExpiryMs();
  if (!next) return;
  const std::int64_t wait = std::clamp<std::int64_t>(*next - nowMs(), 1, kLongestWaitMs);
  _expiryTimer = g_timeout_add(static_cast<guint>(wait), expiryCb, this);
}

gboolean ShareDesk::expiryCb(gpointer self) {
  auto* desk = static_cast<ShareDesk*>(self);
  desk->_expiryTimer = 0;
  desk->expireOverdue();
  return G_SOURCE_REMOVE;
}

}  // namespace service
