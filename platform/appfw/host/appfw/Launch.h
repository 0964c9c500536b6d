/// The sending end of launch requests.
#pragma once

#include <app_control.h>
#include <bundle.h>

#include <functional>
#include <string>

namespace appfw {

/// What becomes of a launch, told from the default main context.
struct LaunchEvents {
  /// The application has the request (or will never get it). Once.
  std::function<void(bool)> onDelivered;
  /// Wanted when set; then it always comes, once: failed, with an empty bundle, when the
  /// application goes away without a reply. The bundle is valid during the call.
  std::function<void(app_control_result_e, bundle*)> onReply;
};

/// Starts the launch of `appId` with a copy of the bundle and returns without waiting for the
/// application: 0 or one of app_control_error_e, and then no event follows.
int launch(const std::string& appId, const bundle& request, LaunchEvents events);

}  // namespace appfw
