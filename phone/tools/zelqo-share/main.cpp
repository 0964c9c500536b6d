// Shares files as any subscriber, and returns when they have arrived.
#include <common/Owned.h>
#include <zelqo/PhoneSettings.h>
#include <zelqo/Uploader.h>

#include <algorithm>
#include <cstdio>
#include <string>

namespace {

constexpr guint kDeliveryPollMs = 20;
constexpr gint64 kDeliveryPatienceUs = 10 * G_USEC_PER_SEC;

using zelqo::Uploader;

struct Arguments {
  std::string service;
  Uploader::Request request;
};

std::string takeText(char* text) {
  const common::OwnedText owner(text);
  return text ? text : "";
}

std::vector<std::string> splitNumbers(const std::string& text) {
  std::vector<std::string> numbers;
  const common::OwnedTexts parts(g_strsplit(text.c_str(), ",", -1));
  for (char** part = parts.get(); *part; part++) {
    if (**part) numbers.emplace_back(*part);
  }
  return numbers;
}

// The service takes whole paths; the phone's programs run elsewhere.
std::string absolute(const char* path) {
  const common::OwnedText text(g_canonicalize_filename(path, nullptr));
  return text.get();
}

const char* readRawManifest(const std::string& path, std::string& json) {
  common::OwnedText text;
  gsize size = 0;
  char* contents = nullptr;
  if (!g_file_get_contents(path.c_str(), &contents, &size, nullptr)) {
    return "the raw manifest cannot be read";
  }
  text.reset(contents);
  json.assign(contents, size);
  return nullptr;
}

const char* checkArguments(Arguments& arguments, const std::string& rawManifest) {
  Uploader::Request& request = arguments.request;
  if (arguments.service.empty()) arguments.service = zelqo::serviceUrl();
  if (arguments.service.empty()) return "no --service, and the phone has none";
  if (request.from.empty()) return "--from is missing";
  if (request.to.empty()) return "--to is missing";
  if (request.lifetimeS < 1) return "--expires-in takes seconds, at least 1";
  if (!rawManifest.empty()) return readRawManifest(rawManifest, request.rawFiles);
  return request.paths.empty() ? "no files" : nullptr;
}

bool readArguments(int argc, char** argv, Arguments& arguments) {
  Uploader::Request& request = arguments.request;
  char *service = nullptr, *from = nullptr, *to = nullptr, *raw = nullptr;
  char** files = nullptr;
  gboolean single = FALSE;
  gint64 lifetime = request.lifetimeS;
  const GOptionEntry entries[] = {
      {"service", 0, 0, G_OPTION_ARG_STRING, &service, "Sharing service", "URL"},
      {"from", 0, 0, G_OPTION_ARG_STRING, &from, "Sender", "NUMBER"},
      {"to", 0, 0, G_OPTION_ARG_STRING, &to, "Recipients", "NUMBER[,NUMBER...]"},
      {"single", 0, 0, G_OPTION_ARG_NONE, &single, "Mark as a single share", nullptr},
      {"expires-in", 0, 0, G_OPTION_ARG_INT64, &lifetime, "Lifetime", "SECONDS"},
      {"raw-manifest", 0, 0, G_OPTION_ARG_FILENAME, &raw,
       "JSON array to announce instead of the files", "FILE"},
      {G_OPTION_REMAINING, 0, 0, G_OPTION_ARG_FILENAME_ARRAY, &files, nullptr, "FILE..."},
      {nullptr, 0, 0, G_OPTION_ARG_NONE, nullptr, nullptr, nullptr}};
  const common::Owned<GOptionContext, g_option_context_free> context(g_option_context_new(nullptr));
  g_option_context_add_main_entries(context.get(), entries, nullptr);
  common::OwnedError error;
  const bool parsed = g_option_context_parse(context.get(), &argc, &argv, common::Out(error));
  const common::OwnedTexts filesOwner(files);
  arguments.service = takeText(service);
  request.from = takeText(from);
  request.to = splitNumbers(takeText(to));
  request.single = single;
  request.lifetimeS = lifetime;
  const std::string rawManifest = takeText(raw);
  for (char** file = files; file && *file; file++) request.paths.push_back(absolute(*file));
  const char* wrong =
      parsed ? checkArguments(arguments, rawManifest) : (error ? error->message : "arguments");
  if (wrong) fprintf(stderr, "zelqo-share: %s\n", wrong);
  return !wrong;
}

// The upload, and the wait for its push when this phone is among the recipients.
class Sharing {
 public:
  Sharing(GMainLoop* loop, const Arguments& arguments)
      : _loop(loop), _uploader(_store, arguments.service) {
    const std::string own = zelqo::ownNumber();
    const auto& to = arguments.request.to;
    _toSelf = !own.empty() && std::find(to.begin(), to.end(), own) != to.end();
    _uploader.start(arguments.request, nullptr,
                    [this](const Uploader::Result& result) { uploaded(result); });
  }

  int exitCode() const { return _exitCode; }

 private:
  void uploaded(const Uploader::Result& result) {
    if (result.error) {
      fprintf(stderr, "zelqo-share: %s\n", result.reason.c_str());
      end(1);
      return;
    }
    printf("token: %s\nrequest: %lld\n", result.token.c_str(),
           static_cast<long long>(result.requestId));
    fflush(stdout);
    _token = result.token;
    _patienceEnd = g_get_monotonic_time() + kDeliveryPatienceUs;
    if (_toSelf) {
      g_timeout_add(kDeliveryPollMs, deliveredCb, this);
    } else {
      end(0);
    }
  }

  static gboolean deliveredCb(gpointer self) {
    auto* sharing = static_cast<Sharing*>(self);
    const bool delivered = sharing->_store.received(sharing->_token).has_value();
    const bool late = g_get_monotonic_time() > sharing->_patienceEnd;
    if (!delivered && !late) return G_SOURCE_CONTINUE;
    if (!delivered) fputs("zelqo-share: shared, but not delivered to this phone yet\n", stderr);
    sharing->end(delivered ? 0 : 1);
    return G_SOURCE_REMOVE;
  }

  void end(int code) {
    _exitCode = code;
    g_main_loop_quit(_loop);
  }

  GMainLoop* _loop;
  zelqo::Store _store;
  Uploader _uploader;
  bool _toSelf = false;
  std::string _token;
  gint64 _patienceEnd = 0;
  int _exitCode = 0;
};

}  // namespace

int main(int argc, char** argv) {
  Arguments arguments;
  if (!readArguments(argc, argv, arguments)) return 2;
  const common::Owned<GMainLoop, g_main_loop_unref> loop(g_main_loop_new(nullptr, FALSE));
  const Sharing sharing(loop.get(), arguments);
  g_main_loop_run(loop.get());
  return sharing.exitCode();
}
