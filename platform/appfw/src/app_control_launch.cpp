#include "AppControl.h"
#include "BundleVariant.h"
#include "LaunchRecord.h"
#include "PendingLaunch.h"

#include <appfw/BusNames.h>
#include <appfw/Launch.h>
#include <base/Bus.h>
#include <base/Fault.h>
#include <dlog.h>
#include <mime_handler.h>

#include <memory>

namespace appfw {
namespace {

/// Finds an application for a file and shows it there.
constexpr const char* kResolver = "com.orlant.resolver";

/// Empty when the request names no application and nobody can find one for it.
std::string targetOf(const bundle& request) {
  std::string appId = textOf(request, kKeyAppId);
  if (!appId.empty()) return appId;
  const bool findable = textOf(request, kKeyOperation) == APP_CONTROL_OPERATION_VIEW &&
                        mime::resolver_can_open(textOf(request, kKeyUri).c_str());
  return findable ? kResolver : std::string();
}

/// The application's callback with the handles that it expects.
LaunchEvents eventsFor(app_control_h request, app_control_reply_cb callback, void* userData) {
  LaunchEvents events;
  if (!callback) return events;
  app_control_h copy = nullptr;
  app_control_clone(&copy, request);
  std::shared_ptr<app_control_s> kept(copy, app_control_destroy);
  events.onReply = [kept, callback, userData](app_control_result_e result, bundle* contents) {
    OwnedAppControl reply(new app_control_s);
    reply->data->copyFrom(*contents);
    callback(kept.get(), reply.get(), result, userData);
  };
  return events;
}

}  // namespace

int launch(const std::string& appId, const bundle& request, LaunchEvents events) {
  common::OwnedBus bus = base::sessionBus();
  if (!bus) return APP_CONTROL_ERROR_LAUNCH_FAILED;
  if (!isInstalled(bus.get(), appId)) return APP_CONTROL_ERROR_APP_NOT_FOUND;
  common::OwnedVariant contents(g_variant_ref_sink(toVariant(request)));
  if (g_variant_get_size(contents.get()) > kMaxBundleBytes) {
    dlog_print(DLOG_ERROR, "APPFW", "request for %s is larger than %zu bytes", appId.c_str(),
               kMaxBundleBytes);
    return APP_CONTROL_ERROR_LAUNCH_REJECTED;
  }
  recordLaunch(request);
  PendingLaunch::start(std::move(bus), busName(appId), contents.get(), std::move(events));
  return APP_CONTROL_ERROR_NONE;
}

}  // namespace appfw

int app_control_send_launch_request(app_control_h app_control, app_control_reply_cb callback,
                                    void* user_data) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_LAUNCH_FAILED;
  if (!app_control) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  const appfw::OwnedBundle request = appfw::emptyBundle();
  request->copyFrom(*app_control->data);
  request->add(appfw::kKeyOperation, std::string(APP_CONTROL_OPERATION_DEFAULT));
  const std::string target = appfw::targetOf(*request);
  if (target.empty()) return APP_CONTROL_ERROR_APP_NOT_FOUND;
  return appfw::launch(target, *request, appfw::eventsFor(app_control, callback, user_data));
}

int app_control_reply_to_launch_request(app_control_h reply, app_control_h request,
                                        app_control_result_e result) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_LAUNCH_FAILED;
  const bool known = result == APP_CONTROL_RESULT_SUCCEEDED ||
                     result == APP_CONTROL_RESULT_FAILED || result == APP_CONTROL_RESULT_CANCELED;
  if (!reply || !request || request->replyPath.empty() || !known) {
    return APP_CONTROL_ERROR_INVALID_PARAMETER;
  }
  common::OwnedBus bus = base::sessionBus();
  if (!bus) return APP_CONTROL_ERROR_LAUNCH_FAILED;
  common::OwnedVariant contents(g_variant_ref_sink(appfw::toVariant(*reply->data)));
  if (g_variant_get_size(contents.get()) > appfw::kMaxBundleBytes) {
    return APP_CONTROL_ERROR_LAUNCH_REJECTED;
  }
  g_dbus_connection_call(bus.get(), request->replyTo.c_str(), request->replyPath.c_str(),
                         appfw::kReplyInterface, "Reply",
                         g_variant_new("(i@a{sv})", result, contents.get()), nullptr,
                         G_DBUS_CALL_FLAGS_NO_AUTO_START, -1, nullptr, nullptr, nullptr);
  return APP_CONTROL_ERROR_NONE;
}
