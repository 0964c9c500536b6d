#include <base/Bus.h>

#include "BusKeeper.h"
#include "Silence.h"

namespace base {
namespace {

constexpr const char* kBusName = "org.freedesktop.DBus";

/// The bus works through a connection's messages in order: once it has answered this one, it has
/// dealt with those before.
void waitUntilSeen(GDBusConnection* bus) {
  ask(bus, {kBusName, "/org/freedesktop/DBus", kBusName, "GetId"});
}

}  // namespace

common::OwnedBus sessionBus() {
  return BusKeeper::of(BusKind::Session).get();
}

common::OwnedBus systemBus() {
  return BusKeeper::of(BusKind::System).get();
}

common::OwnedVariant ask(GDBusConnection* bus, const Question& question, GError** error) {
  const common::OwnedVariant arguments(question.arguments ? g_variant_ref_sink(question.arguments)
                                                          : nullptr);
  if (Silence::of(bus, kBusName) || Silence::of(bus, question.service)) {
    g_set_error(error, G_IO_ERROR, G_IO_ERROR_TIMED_OUT, "%s is silent", question.service);
    return nullptr;
  }
  common::OwnedError failure;
  common::OwnedVariant answer(g_dbus_connection_call_sync(
      bus, question.service, question.path, question.interface, question.method, arguments.get(),
      question.answerType ? G_VARIANT_TYPE(question.answerType) : nullptr,
      G_DBUS_CALL_FLAGS_NO_AUTO_START, static_cast<int>(question.patience.count()), nullptr,
      common::Out(failure)));
  if (g_error_matches(failure.get(), G_IO_ERROR, G_IO_ERROR_TIMED_OUT)) {
    Silence::begin(bus, question.service);
  }
  if (failure) g_propagate_error(error, failure.release());
  return answer;
}

guint32 requestName(GDBusConnection* bus, const char* name, guint32 flags) {
  // Asked at the start of a program, which is nothing without its name.
  constexpr std::chrono::seconds patience(5);
  const common::OwnedVariant answer(
      ask(bus, {kBusName, "/org/freedesktop/DBus", kBusName, "RequestName",
                g_variant_new("(su)", name, flags), "(u)", patience}));
  guint32 result = 0;
  if (answer) g_variant_get(answer.get(), "(u)", &result);
  return result;
}

bool takeName(GDBusConnection* bus, const char* name) {
  constexpr guint32 doNotQueue = 4;
  constexpr guint32 owner = 1;
  return requestName(bus, name, doNotQueue) == owner;
}

BusReturn::BusReturn(BusKind kind, std::function<void()> returned)
    : _kind(kind), _id(BusKeeper::of(kind).onReturn(std::move(returned))) {}

BusReturn::~BusReturn() {
  BusKeeper::of(_kind).forgetReturn(_id);
}

SignalSubscription::SignalSubscription(BusKind kind, const Match& match,
                                       GDBusSignalCallback callback, void* data)
    : _kind(kind), _match(match), _callback(callback), _data(data), _return(kind, [this] {
        subscribe();
      }) {
  subscribe();
}

SignalSubscription::~SignalSubscription() {
  unsubscribe();
}

void SignalSubscription::subscribe() {
  unsubscribe();
  _bus = BusKeeper::of(_kind).get();
  if (!_bus) return;
  _id = g_dbus_connection_signal_subscribe(_bus.get(), _match.sender, _match.interface,
                                           _match.member, _match.path,
                                           _match.arg0.empty() ? nullptr : _match.arg0.c_str(),
                                           G_DBUS_SIGNAL_FLAGS_NONE, _callback, _data, nullptr);
  waitUntilSeen(_bus.get());
}

void SignalSubscription::unsubscribe() {
  if (_id) g_dbus_connection_signal_unsubscribe(_bus.get(), _id);
  _id = 0;
  _bus.reset();
}

}  // namespace base
