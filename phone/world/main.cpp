// phone-world [NUMBER]: the services of the phone's system bus that a real phone has from its
// hardware and its operating system. Prints "ready" when all of them can be reached.

#include <base/Bus.h>

#include <cstdio>

#include "Battery.h"
#include "Clock.h"
#include "Control.h"
#include "Modem.h"
#include "Network.h"
#include "OrientationSensor.h"

namespace {

bool own(GDBusConnection* bus, const char* name) {
  if (base::takeName(bus, name)) return true;
  fprintf(stderr, "phone-world: %s is taken\n", name);
  return false;
}

bool ownAll(GDBusConnection* bus) {
  for (const char* name :
       {"org.freedesktop.NetworkManager", "net.hadess.SensorProxy", "org.freedesktop.timedate1",
        "org.freedesktop.ModemManager1", "org.freedesktop.UPower", "phone.World"}) {
    if (!own(bus, name)) return false;
  }
  return true;
}

}  // namespace

int main(int argc, char** argv) {
  const common::OwnedBus bus = base::systemBus();
  if (!bus) return 1;
  // With a new bus the world begins anew.
  g_dbus_connection_set_exit_on_close(bus.get(), TRUE);
  Network network(bus.get());
  OrientationSensor sensor(bus.get());
  Clock clock(bus.get());
  Modem modem(bus.get(), argc > 1 ? argv[1] : "");
  Battery battery(bus.get());
  Control control(bus.get(), network, sensor, battery);
  if (!network.publish() || !sensor.publish() || !clock.publish() || !modem.publish() ||
      !battery.publish() || !control.publish() || !ownAll(bus.get())) {
    return 1;
  }
  puts("ready");
  fflush(stdout);
  const common::Owned<GMainLoop, g_main_loop_unref> loop(g_main_loop_new(nullptr, FALSE));
  g_main_loop_run(loop.get());
  return 0;
}
