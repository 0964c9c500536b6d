/// What the list says of a download.
#pragma once

#include <optional>
#include <string>

#include "Download.h"

namespace downloads {

std::string detailOf(const Download& download, bool isHeldBack);

/// "1 min 20 s left", empty when unknown.
std::string timeLeftText(std::optional<double> seconds);

}  // namespace downloads
