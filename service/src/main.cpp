#include <unistd.h>

#include <csignal>
#include <cstdio>

#include <glib-unix.h>

#include "Server.h"

namespace {

struct Arguments {
  service::Text data;
  service::Text tlsCertificate;
  service::Text tlsKey;
  service::Text publicUrl;
  int port = 0;
  int delayMs = 0;
  gboolean refuse = FALSE;
  gboolean lenient = FALSE;
};

bool readArguments(int argc, char** argv, Arguments& arguments) {
  char *data = nullptr, *certificate = nullptr, *key = nullptr, *publicUrl = nullptr;
  const GOptionEntry entries[] = {
      {"data", 0, 0, G_OPTION_ARG_FILENAME, &data, "Folder of database and files", "DIR"},
      {"port", 0, 0, G_OPTION_ARG_INT, &arguments.port, "Port on 127.0.0.1, 0 for any", "N"},
      {"tls-cert", 0, 0, G_OPTION_ARG_FILENAME, &certificate, "Certificate, for HTTPS", "FILE"},
      {"tls-key", 0, 0, G_OPTION_ARG_FILENAME, &key, "Its private key", "FILE"},
      {"public-url", 0, 0, G_OPTION_ARG_STRING, &publicUrl,
       "Where recipients read, when another server does that", "URL"},
      {"delay", 0, 0, G_OPTION_ARG_INT, &arguments.delayMs, "Answer so much later", "MS"},
      {"lenient", 0, 0, G_OPTION_ARG_NONE, &arguments.lenient,
       "Take shares with gaps and addresses of their own, for tests of phones", nullptr},
      {"refuse", 0, 0, G_OPTION_ARG_NONE, &arguments.refuse, "Refuse every request", nullptr},
      {nullptr, 0, 0, G_OPTION_ARG_NONE, nullptr, nullptr, nullptr}};
  const service::Owned<GOptionContext, g_option_context_free> context(
      g_option_context_new("- the sharing service"));
  g_option_context_add_main_entries(context.get(), entries, nullptr);
  service::ErrorOut error;
  const bool parsed = g_option_context_parse(context.get(), &argc, &argv, error);
  arguments.data.reset(data);
  arguments.tlsCertificate.reset(certificate);
  arguments.tlsKey.reset(key);
  arguments.publicUrl.reset(publicUrl);
  const char* wrong = nullptr;
  if (!parsed) {
    wrong = error.message();
  } else if (argc > 1) {
    wrong = "unexpected argument";
  } else if (!data) {
    wrong = "--data is missing";
  } else if (arguments.port < 0 || arguments.port > 65535 || arguments.delayMs < 0) {
    wrong = "number out of range";
  } else if (!certificate != !key) {
    wrong = "--tls-cert and --tls-key belong together";
  }
  if (wrong) fprintf(stderr, "zelqo-service: %s\n", wrong);
  return !wrong;
}

std::string textOf(const service::Text& text) {
  return text ? text.get() : "";
}

// Installed and built next to the service.
std::string thumbnailProgram() {
  const service::Text self(g_file_read_link("/proc/self/exe", nullptr));
  const service::Text folder(g_path_get_dirname(self ? self.get() : "."));
  return std::string(folder.get()) + "/zelqo-thumbnailer";
}

constexpr unsigned kGoodbyeS = 1;

gboolean stopCb(gpointer loop) {
  g_main_loop_quit(static_cast<GMainLoop*>(loop));
  return G_SOURCE_CONTINUE;
}

}  // namespace

int main(int argc, char** argv) {
  Arguments arguments;
  if (!readArguments(argc, argv, arguments)) return 2;
  signal(SIGPIPE, SIG_IGN);

  service::Options options;
  options.data = textOf(arguments.data);
  options.port = static_cast<guint>(arguments.port);
  options.tlsCertificate = textOf(arguments.tlsCertificate);
  options.tlsKey = textOf(arguments.tlsKey);
  options.publicUrl = textOf(arguments.publicUrl);
  options.thumbnailProgram = thumbnailProgram();
  options.delayMs = static_cast<guint>(arguments.delayMs);
  options.refuse = arguments.refuse;
  options.lenient = arguments.lenient;
  service::Server server(std::move(options));
  if (!server.start()) return 1;

  const service::Owned<GMainLoop, g_main_loop_unref> loop(g_main_loop_new(nullptr, FALSE));
  g_unix_signal_add(SIGTERM, stopCb, loop.get());
  g_unix_signal_add(SIGINT, stopCb, loop.get());
  printf("ready: %s\n", server.url().c_str());
  fflush(stdout);
  g_main_loop_run(loop.get());
  // Connections are closed with a goodbye, for which a client may let us wait as long as it likes.
  signal(SIGALRM, [](int) { _exit(0); });
  alarm(kGoodbyeS);
  return 0;
}
