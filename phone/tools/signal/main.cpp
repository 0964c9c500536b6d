// phone-signal MEMBER TEXT: sends the signal as the download application and the history know it.
// phone-signal --record FILE: writes down all signals of the system bus; prints "ready" first.

#include <base/Bus.h>

#include <cstdio>
#include <cstring>

#include "Recorder.h"

namespace {

constexpr const char* kPath = "/com/orlant/remoteshare";
constexpr const char* kInterface = "org.tizen.call.remote.share";
constexpr int kWrongCall = 2;

int fail(const char* why) {
  fprintf(stderr, "phone-signal: %s\n", why);
  return 1;
}

int send(const char* member, const char* text) {
  if (!g_dbus_is_member_name(member)) return fail("that is not the name of a signal");
  if (!g_utf8_validate(text, -1, nullptr)) return fail("the text is not valid UTF-8");
  const common::OwnedBus bus = base::systemBus();
  if (!bus) return 1;
  common::OwnedError error;
  g_dbus_connection_emit_signal(bus.get(), nullptr, kPath, kInterface, member,
                                g_variant_new("(s)", text), common::Out(error));
  if (!error) g_dbus_connection_flush_sync(bus.get(), nullptr, common::Out(error));
  return error ? fail(error->message) : 0;
}

int record(const char* file) {
  if (!base::systemBus()) return 1;
  const Recorder recorder(file);
  if (!recorder.isOpen()) return fail("the record cannot be written");
  puts("ready");
  fflush(stdout);
  const common::Owned<GMainLoop, g_main_loop_unref> loop(g_main_loop_new(nullptr, FALSE));
  g_main_loop_run(loop.get());
  return 0;
}

}  // namespace

int main(int argc, char** argv) {
  if (argc == 3 && strcmp(argv[1], "--record") == 0) return record(argv[2]);
  if (argc == 3) return send(argv[1], argv[2]);
  fputs("phone-signal MEMBER TEXT | phone-signal --record FILE\n", stderr);
  return kWrongCall;
}
