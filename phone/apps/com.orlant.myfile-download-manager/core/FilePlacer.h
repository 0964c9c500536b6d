#pragma once

#include <string>

namespace downloads {

/// Gives a whole part file its final name in the folder. A file of the same name with other content
/// keeps its name, and the new one gets a number; one with the same content is taken for the new
/// one. `earlierPath` is where the same address was stored before, or empty: that file is replaced.
/// Returns the full path, or an empty text when no name could be given.
std::string placeFile(const std::string& partPath, const std::string& folder,
                      const std::string& name, const std::string& earlierPath);

}  // namespace downloads
