// The phone's agent: listens to the sharing service for the phone's number, from boot to shutdown,
// and writes down what it hears.
#include <common/Owned.h>
#include <vconf.h>
#include <zelqo/PhoneSettings.h>
#include <zelqo/PushListener.h>

#include <glib-unix.h>

#include <cstdio>
#include <memory>

namespace {

constexpr const char* kSettings[] = {"db/zelqo/msisdn", "db/zelqo/service_url"};

class Agent {
 public:
  Agent() {
    for (const char* key : kSettings) vconf_notify_key_changed(key, changedCb, this);
    listen();
  }
  ~Agent() {
    for (const char* key : kSettings) vconf_ignore_key_changed(key, changedCb);
  }
  Agent(const Agent&) = delete;
  Agent& operator=(const Agent&) = delete;

 private:
  // Not at once: the callback comes from within the settings.
  static void changedCb(keynode_t*, void* self) {
    auto* agent = static_cast<Agent*>(self);
    if (!agent->_change) agent->_change = g_idle_add(listenCb, self);
  }

  static gboolean listenCb(gpointer self) {
    auto* agent = static_cast<Agent*>(self);
    agent->_change = 0;
    agent->listen();
    return G_SOURCE_REMOVE;
  }

  void listen() {
    const std::string number = zelqo::ownNumber();
    const std::string url = zelqo::serviceUrl();
    _listener.reset();
    if (number.empty() || url.empty()) {
      g_message("no number or no sharing service; waiting for the settings");
      ready();
      return;
    }
    _listener = std::make_unique<zelqo::PushListener>(_store, number, url);
    _listener->start([] { ready(); });
  }

  static void ready() {
    puts("ready");
    fflush(stdout);
  }

  zelqo::Store _store;
  std::unique_ptr<zelqo::PushListener> _listener;
  guint _change = 0;
};

gboolean stopCb(gpointer loop) {
  g_main_loop_quit(static_cast<GMainLoop*>(loop));
  return G_SOURCE_CONTINUE;
}

}  // namespace

int main() {
  const common::Owned<GMainLoop, g_main_loop_unref> loop(g_main_loop_new(nullptr, FALSE));
  g_unix_signal_add(SIGTERM, stopCb, loop.get());
  g_unix_signal_add(SIGINT, stopCb, loop.get());
  const Agent agent;
  g_main_loop_run(loop.get());
  return 0;
}
