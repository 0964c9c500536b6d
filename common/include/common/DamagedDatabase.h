/// What to do about a database file that cannot be worked with.
#pragma once

#include <string>

namespace common {

enum class Examined {
  Sound,     ///< another process has put a sound file there, or the failure was a passing one
  SetAside,  ///< it was damaged and has its new name; a new one may be begun
  Unusable,  ///< damaged and not to be moved, or not to be opened at all
};

/// Looks through the file and, when it is damaged, renames it, with its companions, to `aside`.
/// Processes that examine the same file do so one after another; the caller has it not open.
Examined examineDatabase(const std::string& path, const std::string& aside);

}  // namespace common
