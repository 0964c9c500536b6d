/// Pictures in a folder: there under their final names when they are whole, not before.
#pragma once

#include <string>

namespace zelqo {

enum class PictureSaved { Whole, NoPicture, Failed };

/// Writes what came from the address; `path` is set when it is whole. The names come from a hash of
/// the address, never from the address itself. For any thread.
PictureSaved savePicture(const std::string& folder, const std::string& url,
                         const std::string& content, std::string& path);

/// Removes what processes that ended in the middle have left in the folder.
void removePictureLeftovers(const std::string& folder);

}  // namespace zelqo
