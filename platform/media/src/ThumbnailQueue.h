#pragma once

#include <string>

namespace media {

/// Asks the desktop's thumbnailer for a thumbnail, once per file and process, and does not wait:
/// all requests of one turn of the main loop travel together.
void queueThumbnail(const std::string& path, const std::string& mimeType);

}  // namespace media
