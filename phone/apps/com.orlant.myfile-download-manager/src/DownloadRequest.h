#pragma once

#include <app_control.h>

#include <vector>

#include "Download.h"

namespace downloads {

/// The files that a launch request asks for; none when it only opens the list.
std::vector<Download> readRequest(app_control_h request);

}  // namespace downloads
