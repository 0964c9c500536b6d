/// Opens a file in the program of the phone that is made for it. Has no window and ends when
/// nothing was asked of it for a while.

#include <appfw/AppId.h>
#include <appfw/AppService.h>
#include <gio/gio.h>
#include <mime_handler.h>

#include <cstdlib>
#include <string>
#include <type_traits>

namespace {

constexpr unsigned int kIdleSeconds = 30;

using OwnedRequest = common::Owned<std::remove_pointer_t<app_control_h>, app_control_destroy>;

std::string pathOf(app_control_h request) {
  char* raw = nullptr;
  app_control_get_uri(request, &raw);
  const common::OwnedPlainText uri(raw);
  return uri ? mime::pathOfUri(uri.get()) : std::string();
}

/// Empty when the program runs, else why not.
std::string open(const std::string& path) {
  const auto handler = mime::handlerFor(path);
  if (!handler) return "no program for this file";
  const common::OwnedObject<GFile> file(g_file_new_for_path(path.c_str()));
  GList files{file.get(), nullptr, nullptr};
  common::OwnedError error;
  g_app_info_launch(handler.get(), &files, nullptr, common::Out(error));
  return error ? error->message : "";
}

void reply(app_control_h request, const std::string& failure) {
  app_control_h raw = nullptr;
  app_control_create(&raw);
  const OwnedRequest answer(raw);
  if (!failure.empty()) app_control_add_extra_data(raw, "errorMessage", failure.c_str());
  app_control_reply_to_launch_request(
      raw, request, failure.empty() ? APP_CONTROL_RESULT_SUCCEEDED : APP_CONTROL_RESULT_FAILED);
}

class Resolver {
 public:
  int run() {
    if (!_service.start([this] { g_main_loop_quit(_loop.get()); })) return EXIT_FAILURE;
    _service.deliverTo([this](app_control_h request) { _resolve(request); });
    _endLater();
    g_main_loop_run(_loop.get());
    return EXIT_SUCCESS;
  }

 private:
  void _resolve(app_control_h request) {
    const std::string path = pathOf(request);
    const std::string failure = open(path);
    if (!failure.empty()) g_warning("resolver: %s: %s", path.c_str(), failure.c_str());
    reply(request, failure);
    _endLater();
  }

  void _endLater() {
    if (_idleSource) g_source_remove(_idleSource);
    _idleSource = g_timeout_add_seconds(kIdleSeconds, _idleCb, this);
  }

  static gboolean _idleCb(gpointer data) {
    auto* resolver = static_cast<Resolver*>(data);
    resolver->_idleSource = 0;
    g_main_loop_quit(resolver->_loop.get());
    return G_SOURCE_REMOVE;
  }

  common::Owned<GMainLoop, g_main_loop_unref> _loop{g_main_loop_new(nullptr, FALSE)};
  appfw::AppService _service{appfw::applicationId()};
  guint _idleSource = 0;
};

}  // namespace

int main() {
  return Resolver().run();
}
