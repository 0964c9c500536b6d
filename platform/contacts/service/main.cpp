// phone-contacts: the phone's contacts service. Prints "ready" when it can be asked.

#include <base/Bus.h>

#include <cstdio>

#include "ContactsService.h"

int main() {
  const common::OwnedBus bus = base::sessionBus();
  if (!bus) return 1;
  contacts::ContactsService service(bus.get());
  if (!service.start()) return 1;
  puts("ready");
  fflush(stdout);
  const common::Owned<GMainLoop, g_main_loop_unref> loop(g_main_loop_new(nullptr, FALSE));
  g_main_loop_run(loop.get());
  return 0;
}
