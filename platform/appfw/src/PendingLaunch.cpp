#include "PendingLaunch.h"

#include "BundleVariant.h"

#include <appfw/BusNames.h>
#include <dlog.h>

namespace appfw {
namespace {

using common::Out;
using common::OwnedError;
using common::OwnedMessage;
using common::OwnedVariant;

constexpr int kDeliveryTimeoutMs = 15000;

GDBusInterfaceInfo* replyInterface() {
  static GDBusNodeInfo* node = g_dbus_node_info_new_for_xml(
      "<node><interface name='phone.AppReply1'><method name='Reply'>"
      "<arg type='i' direction='in'/><arg type='a{sv}' direction='in'/>"
      "</method></interface></node>",
      nullptr);
  return node->interfaces[0];
}

std::string newReplyPath() {
  static unsigned count = 0;
  return "/phone/AppReply/" + std::to_string(++count);
}

app_control_result_e resultOf(int number) {
  switch (number) {
    case APP_CONTROL_RESULT_SUCCEEDED:
      return APP_CONTROL_RESULT_SUCCEEDED;
    case APP_CONTROL_RESULT_CANCELED:
      return APP_CONTROL_RESULT_CANCELED;
    default:
      return APP_CONTROL_RESULT_FAILED;
  }
}

}  // namespace

void PendingLaunch::start(common::OwnedBus bus, std::string name, GVariant* contents,
                          LaunchEvents events) {
  auto* launch = new PendingLaunch(std::move(bus), std::move(name), contents, std::move(events));
  launch->listenForReply();
  launch->send();
}

PendingLaunch::PendingLaunch(common::OwnedBus bus, std::string name, GVariant* contents,
                             LaunchEvents events)
    : _bus(std::move(bus)),
      _name(std::move(name)),
      _contents(g_variant_ref_sink(contents)),
      _events(std::move(events)) {}

PendingLaunch::~PendingLaunch() {
  if (_watch) g_bus_unwatch_name(_watch);
  if (_object) g_dbus_connection_unregister_object(_bus.get(), _object);
}

void PendingLaunch::listenForReply() {
  if (!_events.onReply) return;
  static const GDBusInterfaceVTable calls = {replyCb, nullptr, nullptr, {}};
  _replyPath = newReplyPath();
  _object = g_dbus_connection_register_object(_bus.get(), _replyPath.c_str(), replyInterface(),
                                              &calls, this, nullptr, nullptr);
}

/// A whole message instead of a plain call: its answer tells the unique name of the callee, which
/// stays the same process while the well-known name may pass to another.
void PendingLaunch::send() {
  OwnedMessage message(
      g_dbus_message_new_method_call(_name.c_str(), kAppPath, kAppInterface, "Launch"));
  g_dbus_message_set_body(message.get(),
                          g_variant_new("(@a{sv}o)", _contents.get(), _replyPath.c_str()));
  g_dbus_connection_send_message_with_reply(_bus.get(), message.get(),
                                            G_DBUS_SEND_MESSAGE_FLAGS_NONE, kDeliveryTimeoutMs,
                                            nullptr, nullptr, sentCb, this);
}

void PendingLaunch::sentCb(GObject* bus, GAsyncResult* result, void* data) {
  OwnedError error;
  OwnedMessage answer(
      g_dbus_connection_send_message_with_reply_finish(G_DBUS_CONNECTION(bus), result, Out(error)));
  if (answer) g_dbus_message_to_gerror(answer.get(), Out(error));
  static_cast<PendingLaunch*>(data)->sent(answer.get(), error.get());
}

void PendingLaunch::sent(GDBusMessage* answer, const GError* error) {
  if (!error) {
    delivered(g_dbus_message_get_sender(answer));
    return;
  }
  // The application may just have been quitting: asked again, the bus starts it anew.
  if (g_error_matches(error, G_DBUS_ERROR, G_DBUS_ERROR_NO_REPLY) && !_retried) {
    _retried = true;
    send();
    return;
  }
  dlog_print(DLOG_ERROR, "APPFW", "launch of %s failed: %s", _name.c_str(), error->message);
  if (_events.onDelivered) _events.onDelivered(false);
  finish(APP_CONTROL_RESULT_FAILED, emptyBundle());
}

void PendingLaunch::delivered(const char* callee) {
  _callee = callee ? callee : "";
  if (_events.onReply) {
    _watch =
        g_bus_watch_name_on_connection(_bus.get(), _callee.c_str(), G_BUS_NAME_WATCHER_FLAGS_NONE,
                                       nullptr, vanishedCb, this, nullptr);
  }
  const bool replyWanted = static_cast<bool>(_events.onReply);
  if (_events.onDelivered) _events.onDelivered(true);
  if (!replyWanted) delete this;
}

void PendingLaunch::vanishedCb(GDBusConnection*, const char*, void* data) {
  static_cast<PendingLaunch*>(data)->finish(APP_CONTROL_RESULT_FAILED, emptyBundle());
}

void PendingLaunch::replyCb(GDBusConnection*, const char* sender, const char*, const char*,
                            const char*, GVariant* arguments, GDBusMethodInvocation* invocation,
                            void* data) {
  static_cast<PendingLaunch*>(data)->replied(sender, arguments, invocation);
}

void PendingLaunch::replied(const char* sender, GVariant* arguments,
                            GDBusMethodInvocation* invocation) {
  if (sender != _callee || g_variant_get_size(arguments) > kMaxBundleBytes) {
    dlog_print(DLOG_WARN, "APPFW", "reply of %s to the launch of %s is refused", sender,
               _name.c_str());
    g_dbus_method_invocation_return_error_literal(invocation, G_DBUS_ERROR,
                                                  G_DBUS_ERROR_ACCESS_DENIED, "not your request");
    return;
  }
  int result = APP_CONTROL_RESULT_FAILED;
  GVariant* contents = nullptr;
  g_variant_get(arguments, "(i@a{sv})", &result, &contents);
  OwnedVariant owned(contents);
  g_dbus_method_invocation_return_value(invocation, nullptr);
  finish(resultOf(result), fromVariant(contents));
}

/// Deletes the object before it calls out: whoever is told may end the application.
void PendingLaunch::finish(app_control_result_e result, OwnedBundle reply) {
  const auto onReply = std::move(_events.onReply);
  delete this;
  if (onReply) onReply(result, reply.get());
}

}  // namespace appfw
