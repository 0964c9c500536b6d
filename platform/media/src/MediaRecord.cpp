#include "MediaRecord.h"

#include <common/Owned.h>

#include "ThumbnailQueue.h"

namespace media {
namespace {

constexpr const char* kAttributes = G_FILE_ATTRIBUTE_STANDARD_TYPE
    "," G_FILE_ATTRIBUTE_STANDARD_FAST_CONTENT_TYPE "," G_FILE_ATTRIBUTE_TIME_MODIFIED;

using OwnedFile = common::OwnedObject<GFile>;
using OwnedInfo = common::OwnedObject<GFileInfo>;

OwnedInfo query(const std::string& path, const char* attributes) {
  const OwnedFile file(g_file_new_for_path(path.c_str()));
  return OwnedInfo(
      g_file_query_info(file.get(), attributes, G_FILE_QUERY_INFO_NONE, nullptr, nullptr));
}

guint64 modified(GFileInfo* info) {
  return g_file_info_get_attribute_uint64(info, G_FILE_ATTRIBUTE_TIME_MODIFIED);
}

/// Where the desktop's thumbnailer keeps it. GIO would find the smaller ones only.
std::string thumbnailPath(const std::string& path) {
  const common::OwnedText uri(g_filename_to_uri(path.c_str(), nullptr, nullptr));
  if (!uri) return {};
  const common::OwnedText hash(g_compute_checksum_for_string(G_CHECKSUM_MD5, uri.get(), -1));
  return std::string(g_get_user_cache_dir()) + "/thumbnails/" + kThumbnailSize + "/" + hash.get() +
         ".png";
}

std::string currentThumbnail(const std::string& path, GFileInfo* info) {
  const std::string thumbnail = thumbnailPath(path);
  const auto made = query(thumbnail, G_FILE_ATTRIBUTE_TIME_MODIFIED);
  return made && modified(made.get()) >= modified(info) ? thumbnail : "";
}

std::string mimeTypeOf(GFileInfo* info) {
  const char* type =
      g_file_info_get_attribute_string(info, G_FILE_ATTRIBUTE_STANDARD_FAST_CONTENT_TYPE);
  const common::OwnedText mimeType(type ? g_content_type_get_mime_type(type) : nullptr);
  return mimeType ? mimeType.get() : "application/octet-stream";
}

bool hasPicture(const std::string& mimeType) {
  return mimeType.compare(0, 6, "image/") == 0 || mimeType.compare(0, 6, "video/") == 0;
}

}  // namespace

std::optional<MediaRecord> lookUp(const std::string& path) {
  const auto info = query(path, kAttributes);
  if (!info || g_file_info_get_attribute_uint32(info.get(), G_FILE_ATTRIBUTE_STANDARD_TYPE) !=
                   G_FILE_TYPE_REGULAR) {
    return {};
  }
  MediaRecord record{path, mimeTypeOf(info.get()), currentThumbnail(path, info.get())};
  if (record.thumbnail.empty() && hasPicture(record.mimeType)) {
    queueThumbnail(record.path, record.mimeType);
  }
  return record;
}

}  // namespace media
