#pragma once

#include <string>

namespace media {

/// Of 512 pixels: a photo that was sent is shown from it on a whole page, too.
constexpr char kThumbnailSize[] = "x-large";

/// Asks the desktop's thumbnailer for a thumbnail, once per file and process, and does not wait:
/// all requests of one turn of the main loop travel together.
void queueThumbnail(const std::string& path, const std::string& mimeType);

}  // namespace media
