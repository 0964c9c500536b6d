/// File names from strangers, made fit for the download folder.
#pragma once

#include <string>

namespace downloads {

/// A plain, visible file name of at most 255 bytes that reads as it is stored: no folder, no
/// control or direction-changing characters, never empty, the extension kept.
std::string safeName(const std::string& name);

/// safeName with " (n)" before the extension; n = 0 is the name itself.
std::string numberedName(const std::string& safeName, unsigned int n);

}  // namespace downloads
