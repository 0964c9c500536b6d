#pragma once

#include <string>

namespace downloads {

/// Shows the file in its folder, in whatever file manager the phone has; a message when it has
/// none.
void showInFolder(const std::string& path);

}  // namespace downloads
