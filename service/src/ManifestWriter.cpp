#include "ManifestWriter.h"

#include <common/Json.h>

namespace service {
namespace {

void writeAddress(common::JsonWriter& json, const char* member,
                  const std::optional<std::string>& own, BlobKind kind, std::int64_t index,
                  bool there) {
  if (own) {
    json.text(member, *own);
  } else if (there) {
    json.text(member, std::string(blobWord(kind)) + "/" + std::to_string(index));
  }
}

void writeFile(common::JsonWriter& json, const ShareFile& file, std::int64_t id, std::int64_t index,
               const BlobStore& blobs) {
  const auto there = [&](BlobKind kind) { return blobs.stagedSize(id, kind, index).has_value(); };
  json.open();
  if (file.name) json.text("name", *file.name);
  if (file.size) json.number("size", *file.size);
  if (file.type) json.text("type", *file.type);
  writeAddress(json, "url", file.url, BlobKind::File, index, true);
  writeAddress(json, "thumb", file.thumb, BlobKind::Thumb, index, there(BlobKind::Thumb));
  writeAddress(json, "mid", file.mid, BlobKind::Mid, index, there(BlobKind::Mid));
  writeAddress(json, "big", file.big, BlobKind::Big, index, there(BlobKind::Big));
  json.close();
}

}  // namespace

std::string writeManifest(const Share& share, const std::vector<ShareFile>& files,
                          const BlobStore& blobs) {
  common::JsonWriter json;
  json.open()
      .text("token", share.token)
      .text("from", share.sender)
      .flag("single", share.single)
      .number("created_ms", share.createdMs)
      .number("expires_ms", share.expiresMs)
      .openArray("files");
  std::int64_t index = 0;
  for (const ShareFile& file : files) writeFile(json, file, share.id, index++, blobs);
  return json.closeArray().close().str();
}

}  // namespace service
