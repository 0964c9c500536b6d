#include "TestPhone.h"

#include <signal.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>

namespace {

std::string& rootFolder() {
  static std::string folder;
  return folder;
}

GPid& busProcess() {
  static GPid process = 0;
  return process;
}

std::string busConfig() {
  return rootFolder() + "/bus.conf";
}

void endBus() {
  kill(busProcess(), SIGKILL);
  waitpid(busProcess(), nullptr, 0);
}

/// Starts a bus that ends with this program, and makes it the session and the system bus.
GPid startBus(const std::string& config) {
  const std::string file = "--config-file=" + config;
  const char* const command[] = {"dbus-daemon",       file.c_str(), "--nofork",
                                 "--print-address=1", "--nosyslog", nullptr};
  GPid pid = 0;
  int output = -1;
  common::OwnedError error;
  g_spawn_async_with_pipes(
      nullptr, const_cast<char**>(command), nullptr,
      static_cast<GSpawnFlags>(G_SPAWN_SEARCH_PATH | G_SPAWN_DO_NOT_REAP_CHILD |
                               G_SPAWN_STDERR_TO_DEV_NULL),
      [](void*) { prctl(PR_SET_PDEATHSIG, SIGKILL); }, nullptr, &pid, nullptr, &output, nullptr,
      common::Out(error));
  std::string address;
  for (char c; read(output, &c, 1) == 1 && c != '\n';) address += c;
  close(output);
  setenv("DBUS_SESSION_BUS_ADDRESS", address.c_str(), 1);
  setenv("DBUS_SYSTEM_BUS_ADDRESS", address.c_str(), 1);
  return pid;
}

}  // namespace

/// Set before anything looks: applications find out once who and where they are.
TestPhone::TestPhone() {
  char folder[] = "/tmp/phone-test-XXXXXX";
  rootFolder() = mkdtemp(folder);
  setenv("APPFW_ROOT", folder, 1);
  setenv("APPFW_APP_ID", kAppId, 1);
}

void TestPhone::SetUp() {
  const std::string services = root() + "/services";
  g_mkdir_with_parents(services.c_str(), 0755);
  writeFile(busConfig(),
            "<busconfig><type>session</type><listen>unix:path=" + root() +
                "/bus</listen><auth>EXTERNAL</auth><servicedir>" + services +
                "</servicedir><policy context=\"default\"><allow user=\"*\"/><allow own=\"*\"/>"
                "<allow send_destination=\"*\" eavesdrop=\"true\"/><allow "
                "eavesdrop=\"true\"/></policy></busconfig>");
  busProcess() = startBus(busConfig());
  for (const auto& bus : {base::sessionBus().release(), base::systemBus().release()}) {
    g_dbus_connection_set_exit_on_close(bus, FALSE);
  }
}

void TestPhone::TearDown() {
  endBus();
  std::filesystem::remove_all(root());
}

GPid TestPhone::bus() {
  return busProcess();
}

void TestPhone::replaceBus() {
  endBus();
  busProcess() = startBus(busConfig());
}

std::string TestPhone::root() {
  return rootFolder();
}

void TestPhone::install(const std::string& appId, const std::string& command) {
  const std::string name = "phoneapp.i" + appId;
  writeFile(root() + "/services/" + name + ".service",
            "[D-BUS Service]\nName=" + name + "\nExec=/usr/bin/env APPFW_APP_ID=" + appId + " " +
                command + "\n");
  common::OwnedBus bus = base::sessionBus();
  common::OwnedVariant done(g_dbus_connection_call_sync(
      bus.get(), "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus",
      "ReloadConfig", nullptr, nullptr, G_DBUS_CALL_FLAGS_NONE, -1, nullptr, nullptr));
}

void settle() {
  common::OwnedBus bus = base::sessionBus();
  bool answered = false;
  g_dbus_connection_call(
      bus.get(), "org.freedesktop.DBus", "/org/freedesktop/DBus", "org.freedesktop.DBus", "GetId",
      nullptr, nullptr, G_DBUS_CALL_FLAGS_NONE, -1, nullptr,
      [](GObject* source, GAsyncResult* result, void* data) {
        common::OwnedVariant answer(
            g_dbus_connection_call_finish(G_DBUS_CONNECTION(source), result, nullptr));
        *static_cast<bool*>(data) = true;
      },
      &answered);
  waitUntil([&] { return answered; });
  while (g_main_context_iteration(nullptr, FALSE)) {
  }
}

common::OwnedBus otherConnection() {
  return common::OwnedBus(g_dbus_connection_new_for_address_sync(
      getenv("DBUS_SESSION_BUS_ADDRESS"),
      static_cast<GDBusConnectionFlags>(G_DBUS_CONNECTION_FLAGS_AUTHENTICATION_CLIENT |
                                        G_DBUS_CONNECTION_FLAGS_MESSAGE_BUS_CONNECTION),
      nullptr, nullptr, nullptr));
}

std::string readFile(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  std::ostringstream text;
  text << file.rdbuf();
  return text.str();
}

void writeFile(const std::string& path, const std::string& contents) {
  std::filesystem::create_directories(std::filesystem::path(path).parent_path());
  std::ofstream(path, std::ios::binary) << contents;
}

std::string take(char* text) {
  std::string copy = text ? text : "(null)";
  free(text);
  return copy;
}
