#include "Modem.h"

#include <algorithm>

namespace {

constexpr const char* kManager = R"(<node><interface name="org.freedesktop.DBus.ObjectManager">
<method name="GetManagedObjects"><arg type="a{oa{sa{sv}}}" direction="out"/></method>
</interface></node>)";

constexpr const char* kModem = R"(<node><interface name="org.freedesktop.ModemManager1.Modem">
<property name="Sim" type="o" access="read"/>
<property name="State" type="i" access="read"/>
<property name="OwnNumbers" type="as" access="read"/>
<property name="Manufacturer" type="s" access="read"/>
<property name="Model" type="s" access="read"/>
</interface></node>)";

constexpr const char* kCard = R"(<node><interface name="org.freedesktop.ModemManager1.Sim">
<property name="Active" type="b" access="read"/>
<property name="SimIdentifier" type="s" access="read"/>
<property name="Imsi" type="s" access="read"/>
<property name="OperatorIdentifier" type="s" access="read"/>
<property name="OperatorName" type="s" access="read"/>
</interface></node>)";

constexpr gint kRegistered = 8;
constexpr const char* kOperator = "00101";  // the test network of the numbering plan
constexpr size_t kSubscriberDigits = 10;

/// An IMSI that belongs to this number alone.
std::string imsi(std::string number) {
  number.erase(
      std::remove_if(number.begin(), number.end(), [](char c) { return !g_ascii_isdigit(c); }),
      number.end());
  if (number.size() > kSubscriberDigits) number.erase(0, number.size() - kSubscriberDigits);
  return kOperator + std::string(kSubscriberDigits - number.size(), '0') + number;
}

}  // namespace

Modem::Modem(GDBusConnection* bus, const std::string& number)
    : _manager(bus, "/org/freedesktop/ModemManager1", kManager),
      _modem(bus, "/org/freedesktop/ModemManager1/Modem/0", kModem),
      _card(bus, "/org/freedesktop/ModemManager1/SIM/0", kCard) {
  const char* const own = number.c_str();
  _modem.set("Sim", g_variant_new_object_path(_card.path().c_str()));
  _modem.set("State", g_variant_new_int32(kRegistered));
  _modem.set("OwnNumbers", g_variant_new_strv(&own, 1));
  _modem.set("Manufacturer", g_variant_new_string("phone"));
  _modem.set("Model", g_variant_new_string("simulated"));
  _card.set("Active", g_variant_new_boolean(TRUE));
  _card.set("SimIdentifier", g_variant_new_string(("89" + imsi(number)).c_str()));
  _card.set("Imsi", g_variant_new_string(imsi(number).c_str()));
  _card.set("OperatorIdentifier", g_variant_new_string(kOperator));
  _card.set("OperatorName", g_variant_new_string("Test network"));
  _manager.onMethod("GetManagedObjects",
                    [this](GVariant*, const std::string&, GError**) { return _managedObjects(); });
}

bool Modem::publish() {
  return _card.publish() && _modem.publish() && _manager.publish();
}

/// The modem; SIM cards are not among the managed objects.
GVariant* Modem::_managedObjects() const {
  GVariantBuilder objects;
  g_variant_builder_init(&objects, G_VARIANT_TYPE("a{oa{sa{sv}}}"));
  g_variant_builder_open(&objects, G_VARIANT_TYPE("{oa{sa{sv}}}"));
  g_variant_builder_add(&objects, "o", _modem.path().c_str());
  g_variant_builder_open(&objects, G_VARIANT_TYPE("a{sa{sv}}"));
  g_variant_builder_add(&objects, "{s@a{sv}}", _modem.interface(), _modem.properties());
  g_variant_builder_close(&objects);
  g_variant_builder_close(&objects);
  return g_variant_new("(a{oa{sa{sv}}})", &objects);
}
