#include "VconfChanges.h"

#include <algorithm>

struct _keynode_t {
  std::string name;
};

char* vconf_keynode_get_name(keynode_t* node) {
  return node ? node->name.data() : nullptr;
}

/// Flushed, since whoever sets a key may be a tool that ends right afterwards.
void VconfChanges::announce(const std::string& key) {
  common::OwnedBus bus = base::sessionBus();
  if (!bus) return;
  common::OwnedText text(g_utf8_make_valid(key.c_str(), -1));
  g_dbus_connection_emit_signal(bus.get(), nullptr, kPath, kInterface, kSignal,
                                g_variant_new("(s)", text.get()), nullptr);
  g_dbus_connection_flush_sync(bus.get(), nullptr, nullptr);
}

void VconfChanges::add(const std::string& key, vconf_callback_fn callback, void* data) {
  if (!_subscription) {
    _subscription = std::make_unique<base::SignalSubscription>(
        base::BusKind::Session,
        base::SignalSubscription::Match{nullptr, kInterface, kSignal, kPath}, changedCb, this);
  }
  _listeners.push_back(std::make_shared<Listener>(Listener{key, callback, data}));
}

bool VconfChanges::remove(const std::string& key, vconf_callback_fn callback) {
  const auto listener =
      std::find_if(_listeners.begin(), _listeners.end(), [&](const auto& candidate) {
        return candidate->key == key && candidate->callback == callback;
      });
  if (listener == _listeners.end()) return false;
  (*listener)->removed = true;
  _listeners.erase(listener);
  return true;
}

void VconfChanges::changedCb(GDBusConnection*, const char*, const char*, const char*, const char*,
                             GVariant* arguments, void* data) {
  if (!g_variant_is_of_type(arguments, G_VARIANT_TYPE("(s)"))) return;
  const char* key = nullptr;
  g_variant_get(arguments, "(&s)", &key);
  static_cast<VconfChanges*>(data)->changed(key);
}

/// Callbacks may add and remove listeners.
void VconfChanges::changed(const std::string& key) {
  const auto listeners = _listeners;
  keynode_t node{key};
  for (const auto& listener : listeners) {
    if (!listener->removed && listener->key == key) listener->callback(&node, listener->data);
  }
}
