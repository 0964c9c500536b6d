#pragma once

#include <optional>
#include <string>

namespace media {

/// What the phone knows of one file.
struct MediaRecord {
  std::string path;
  std::string mimeType;
  std::string thumbnail;  ///< empty when there is none (yet)
};

/// Nothing when there is no plain file. A picture or video without a current thumbnail is queued
/// with the thumbnailer, for the next time.
std::optional<MediaRecord> lookUp(const std::string& path);

}  // namespace media
