/// The phone's folders.
#pragma once

#include <string>

namespace base {

/// "/opt/usr", or what the environment variable APPFW_ROOT says. No slash at the end.
std::string phoneRoot();
/// The platform's own databases.
std::string databaseFolder();
/// "…/apps/<id>/", or an empty text when `appId` cannot be a folder's name.
std::string applicationFolder(const std::string& appId);

}  // namespace base
