#include <notification/post.h>

#include "Notify.h"

#include <base/Bus.h>

#include <map>
#include <memory>

namespace notification {
namespace {

constexpr int kShownMs = 5000;

using OnOpen = std::function<void()>;

/// What to do when a message is opened, until it is closed.
class OpenActions {
 public:
  OpenActions()
      : _signals(base::BusKind::Session, {kService, kService, nullptr, kPath}, signalCb, this) {}

  void add(unsigned number, OnOpen onOpen) { _actions[number] = std::move(onOpen); }

 private:
  static void signalCb(GDBusConnection*, const char*, const char*, const char*, const char* signal,
                       GVariant* arguments, void* data) {
    auto* self = static_cast<OpenActions*>(data);
    const std::string name(signal);
    guint32 number = 0;
    if (name == "ActionInvoked" && g_variant_is_of_type(arguments, G_VARIANT_TYPE("(us)"))) {
      g_variant_get_child(arguments, 0, "u", &number);
      self->invoked(number);
    } else if (name == "NotificationClosed" &&
               g_variant_is_of_type(arguments, G_VARIANT_TYPE("(uu)"))) {
      g_variant_get_child(arguments, 0, "u", &number);
      self->_actions.erase(number);
    }
  }

  void invoked(unsigned number) {
    const auto action = _actions.find(number);
    if (action == _actions.end()) return;
    const OnOpen onOpen = std::move(action->second);
    _actions.erase(action);
    onOpen();
  }

  std::map<unsigned, OnOpen> _actions;
  base::SignalSubscription _signals;
};

OpenActions& openActions() {
  static OpenActions actions;
  return actions;
}

void shownCb(GObject* bus, GAsyncResult* result, void* data) {
  std::unique_ptr<OnOpen> onOpen(static_cast<OnOpen*>(data));
  const unsigned number = finishNotify(bus, result);
  if (number && *onOpen) openActions().add(number, std::move(*onOpen));
}

}  // namespace

bool post(const std::string& text, OnOpen onOpen) {
  common::OwnedBus bus = base::sessionBus();
  if (text.empty() || !bus) return false;
  openActions();  // listens before the daemon can speak
  Message message;
  message.text = text;
  message.openable = static_cast<bool>(onOpen);
  message.timeoutMs = kShownMs;
  notify(bus.get(), message, shownCb, new OnOpen(std::move(onOpen)));
  return true;
}

}  // namespace notification
