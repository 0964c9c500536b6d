/// Which application this process is.
#pragma once

#include <string>

namespace appfw {

/// From the executable's path (…/apps/<id>/bin/…) or the environment variable APPFW_APP_ID; empty
/// outside an application. Found out once.
const std::string& applicationId();

}  // namespace appfw
