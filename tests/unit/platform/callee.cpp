// An application without a window: does what the request's extra "do" says. Its argument, a file,
// counts its starts.
#include <app_control_internal.h>
#include <appfw/AppId.h>
#include <appfw/AppService.h>
#include <aul.h>
#include <signal.h>
#include <unistd.h>

#include <fstream>
#include <string>

namespace {

std::string text(app_control_h request, const char* key) {
  char* value = nullptr;
  app_control_get_extra_data(request, key, &value);
  std::string copy = value ? value : "";
  free(value);
  return copy;
}

bool copyToReply(app_control_h request, const char* key, void* data) {
  auto* reply = static_cast<app_control_h>(data);
  bool array = false;
  app_control_is_extra_data_array(request, key, &array);
  if (!array) {
    app_control_add_extra_data(reply, key, text(request, key).c_str());
    return true;
  }
  char** texts = nullptr;
  int length = 0;
  app_control_get_extra_data_array(request, key, &texts, &length);
  app_control_add_extra_data_array(reply, key, const_cast<const char**>(texts), length);
  for (int i = 0; i < length; i++) free(texts[i]);
  free(texts);
  return true;
}

/// The request's extras, then what else the callee saw.
void reply(app_control_h request, app_control_result_e result) {
  app_control_h answer = nullptr;
  char* caller = nullptr;
  char* operation = nullptr;
  app_control_create(&answer);
  app_control_foreach_extra_data(request, copyToReply, answer);
  app_control_get_caller(request, &caller);
  app_control_get_operation(request, &operation);
  app_control_add_extra_data(answer, "caller", caller ? caller : "none");
  app_control_add_extra_data(answer, "operation", operation);
  app_control_add_extra_data(answer, "pid", std::to_string(getpid()).c_str());
  app_control_reply_to_launch_request(answer, request, result);
  free(caller);
  free(operation);
  app_control_destroy(answer);
}

void handle(app_control_h request, GMainLoop* loop) {
  const std::string task = text(request, "do");
  if (task == "reply") reply(request, APP_CONTROL_RESULT_SUCCEEDED);
  if (task == "cancel") reply(request, APP_CONTROL_RESULT_CANCELED);
  if (task == "die") _exit(1);
  if (task == "quit") g_main_loop_quit(loop);
}

/// Counts this start; true for the first one.
bool isFirstStart(const char* counter) {
  const bool first = !std::ifstream(counter).good();
  std::ofstream(counter, std::ios::app) << "start\n";
  return first;
}

/// As an application that is on its way out: it has the name, but never looks at the request.
GDBusMessage* dieOnLaunch(GDBusConnection*, GDBusMessage* message, gboolean incoming, void*) {
  const char* member = g_dbus_message_get_member(message);
  if (incoming && member && std::string(member) == "Launch") _exit(0);
  return message;
}

}  // namespace

int main(int argc, char** argv) {
  const std::string mode = argc > 2 ? argv[2] : "";
  const bool first = argc > 1 && isFirstStart(argv[1]);
  common::OwnedBus bus = base::sessionBus();
  if (mode == "--quitting" && first) {
    g_dbus_connection_add_filter(bus.get(), dieOnLaunch, nullptr, nullptr);
  }
  GMainLoop* loop = g_main_loop_new(nullptr, FALSE);
  appfw::AppService service(appfw::applicationId());
  if (!service.start([loop] { g_main_loop_quit(loop); })) return 3;
  service.deliverTo([loop](app_control_h request) { handle(request, loop); });
  g_main_loop_run(loop);
  g_main_loop_unref(loop);
  return 0;
}
