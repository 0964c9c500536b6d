// One object with one interface on the system bus.
#pragma once

#include <common/Owned.h>

#include <functional>
#include <map>
#include <string>

class BusObject {
 public:
  /// What a method answers with (floating or owned; null: nothing). Errors are set, not thrown.
  using Method =
      std::function<GVariant*(GVariant* arguments, const std::string& sender, GError** error)>;

  /// `xml` describes the interface as in D-Bus introspection data. Not on the bus before `publish`.
  BusObject(GDBusConnection* bus, std::string path, const char* xml);
  ~BusObject();
  BusObject(const BusObject&) = delete;
  BusObject& operator=(const BusObject&) = delete;

  const std::string& path() const { return _path; }
  const char* interface() const;

  void onMethod(const std::string& name, Method method) { _methods[name] = std::move(method); }

  /// Takes a floating value. Everybody on the bus hears of a change, unless `tellOnly` says who.
  void set(const std::string& property, GVariant* value);
  GVariant* get(const std::string& property) const;
  /// Changes go only to those that this function calls for, by their unique names.
  void tellOnly(std::function<void(const std::function<void(const char*)>&)> listeners);

  void emit(const char* signal, GVariant* arguments);
  bool publish();
  void withdraw();

  /// All properties as "a{sv}".
  GVariant* properties() const;

 private:
  static void _method(GDBusConnection*, const char* sender, const char*, const char*,
                      const char* name, GVariant* arguments, GDBusMethodInvocation* invocation,
                      gpointer self);
  static GVariant* _property(GDBusConnection*, const char*, const char*, const char*,
                             const char* name, GError** error, gpointer self);
  void _tell(const char* destination, const std::string& property, GVariant* value);

  GDBusConnection* const _bus;
  const std::string _path;
  common::Owned<GDBusNodeInfo, g_dbus_node_info_unref> _info;
  std::map<std::string, common::OwnedVariant> _values;
  std::map<std::string, Method> _methods;
  std::function<void(const std::function<void(const char*)>&)> _listeners;
  guint _registration = 0;
};
