#include <appfw/AppService.h>

#include "AppControl.h"
#include "BundleVariant.h"

#include <appfw/BusNames.h>
#include <aul.h>
#include <dlog.h>

namespace appfw {
namespace {

constexpr const char* kTag = "APPFW";
/// An application that is not ready by then will not be.
constexpr size_t kMaxWaiting = 64;

GDBusInterfaceInfo* appInterface() {
  static GDBusNodeInfo* node = g_dbus_node_info_new_for_xml(
      "<node><interface name='phone.App1'><method name='Launch'>"
      "<arg type='a{sv}' direction='in'/><arg type='o' direction='in'/>"
      "</method></interface></node>",
      nullptr);
  return node->interfaces[0];
}

/// What the sender says about itself gives way to what the bus says.
void setCaller(bundle& request, const Caller& caller, bool replyWanted) {
  for (const char* key : {AUL_K_CALLER_PID, AUL_K_CALLER_APPID, AUL_K_WAIT_RESULT}) {
    request.remove(key);
  }
  request.add(AUL_K_CALLER_PID, std::to_string(caller.pid));
  if (!caller.appId.empty()) request.add(AUL_K_CALLER_APPID, caller.appId);
  if (replyWanted) request.add(AUL_K_WAIT_RESULT, std::string("1"));
}

}  // namespace

AppService::AppService(std::string appId) : _appId(std::move(appId)) {}

AppService::~AppService() {
  if (_named) releaseName(_bus.get(), busName(_appId));
  if (_idle) g_source_remove(_idle);
  if (_object) g_dbus_connection_unregister_object(_bus.get(), _object);
}

bool AppService::start(std::function<void()> onNameLost) {
  static const GDBusInterfaceVTable calls = {methodCb, nullptr, nullptr, {}};
  constexpr unsigned replaceExisting = 2, doNotQueue = 4;
  const std::string name = busName(_appId);
  _onNameLost = std::move(onNameLost);
  _bus = base::sessionBus();
  if (!_bus) return false;
  _object = g_dbus_connection_register_object(_bus.get(), kAppPath, appInterface(), &calls, this,
                                              nullptr, nullptr);
  _nameLost = std::make_unique<base::SignalSubscription>(
      base::BusKind::Session,
      base::SignalSubscription::Match{"org.freedesktop.DBus", "org.freedesktop.DBus", "NameLost",
                                      "/org/freedesktop/DBus", name},
      nameLostCb, this);
  _named = _object && requestName(_bus.get(), name, replaceExisting | doNotQueue);
  if (!_named) dlog_print(DLOG_ERROR, kTag, "%s is running already", _appId.c_str());
  return _named;
}

void AppService::nameLostCb(GDBusConnection*, const char*, const char*, const char*, const char*,
                            GVariant*, void* data) {
  auto* self = static_cast<AppService*>(data);
  const auto onNameLost = self->_onNameLost;
  if (onNameLost) onNameLost();
}

void AppService::methodCb(GDBusConnection*, const char* sender, const char*, const char*,
                          const char*, GVariant* arguments, GDBusMethodInvocation* invocation,
                          void* data) {
  static_cast<AppService*>(data)->launch(sender, arguments, invocation);
}

/// The caller is looked up before the request is acknowledged, for afterwards it may be gone.
void AppService::launch(const char* sender, GVariant* arguments,
                        GDBusMethodInvocation* invocation) {
  if (g_variant_get_size(arguments) > kMaxBundleBytes || _waiting.size() >= kMaxWaiting) {
    dlog_print(DLOG_ERROR, kTag, "launch request of %s is refused: too large or too many", sender);
    g_dbus_method_invocation_return_error_literal(
        invocation, G_DBUS_ERROR, G_DBUS_ERROR_LIMITS_EXCEEDED, "too large or too many");
    return;
  }
  GVariant* contents = nullptr;
  const char* replyPath = nullptr;
  g_variant_get(arguments, "(@a{sv}&o)", &contents, &replyPath);
  common::OwnedVariant owned(contents);
  const bool replyWanted = std::string_view(replyPath) != "/";

  Request request(new app_control_s);
  request->kind = app_control_s::Kind::Received;
  request->data = fromVariant(contents);
  setCaller(*request->data, findCaller(_bus.get(), sender), replyWanted);
  if (replyWanted) {
    request->replyTo = sender;
    request->replyPath = replyPath;
  }
  _waiting.push_back(std::move(request));
  g_dbus_method_invocation_return_value(invocation, nullptr);
  deliverSoon();
}

void AppService::deliverTo(RequestHandler handler) {
  _handler = std::move(handler);
  deliverSoon();
}

void AppService::deliverSoon() {
  if (_handler && !_waiting.empty() && !_idle) {
    _idle = g_idle_add_full(G_PRIORITY_DEFAULT, deliverCb, this, nullptr);
  }
}

gboolean AppService::deliverCb(void* data) {
  auto* self = static_cast<AppService*>(data);
  self->_idle = 0;
  self->deliverNext();
  return G_SOURCE_REMOVE;
}

/// One at a time; the handler comes last, for it may end the application.
void AppService::deliverNext() {
  const Request request = std::move(_waiting.front());
  _waiting.pop_front();
  deliverSoon();
  const auto handler = _handler;
  handler(request.get());
}

}  // namespace appfw
