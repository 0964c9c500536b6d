#include "AlivePage.h"

#include <libsoup/soup.h>

#include <filesystem>
#include <fstream>
#include <memory>

#include "User.h"

namespace fs = std::filesystem;
using phone::Colour;
using phone::Share;
using phone::thePhone;
using phone::Tree;
using phone::waitFor;

namespace {

struct Release {
  void operator()(void* object) const { g_object_unref(object); }
  void operator()(GBytes* bytes) const { g_bytes_unref(bytes); }
};

}  // namespace

void AlivePage::TearDown() {
  thePhone()({"service", "ok"});
  thePhone().closeViewer();
}

std::string serviceAddress() {
  const std::string status = thePhone()({"status"});
  const size_t begin = status.find("http://");
  return status.substr(begin, status.find('\n', begin) - begin);
}

std::string addressOf(const Share& share, const std::string& kind, int file) {
  return serviceAddress() + "/share/" + share.token + "/" + kind + "/" + std::to_string(file);
}

std::string serviceStats() {
  const std::unique_ptr<SoupSession, Release> session(soup_session_new());
  const std::unique_ptr<SoupMessage, Release> message(
      soup_message_new(SOUP_METHOD_GET, (serviceAddress() + "/v1/stats").c_str()));
  const std::unique_ptr<GBytes, Release> bytes(
      soup_session_send_and_read(session.get(), message.get(), nullptr, nullptr));
  if (!bytes) return {};
  gsize size = 0;
  const auto* data = static_cast<const char*>(g_bytes_get_data(bytes.get(), &size));
  return {data, size};
}

long serviceCount(const std::string& kind) {
  const std::string stats = serviceStats();
  const size_t key = stats.find('"' + kind + '"');
  if (key == std::string::npos) return -1;
  return std::stol(stats.substr(stats.find(':', key) + 1));
}

std::string writtenFile(const std::string& name, const std::string& content) {
  std::string path = thePhone().makeFile(name, 0);
  std::ofstream(path, std::ios::binary) << content;
  return path;
}

Share announced(const std::string& files) {
  return thePhone().share({}, {"--raw-manifest", writtenFile("manifest.json", files)});
}

size_t filesIn(const std::string& folder) {
  std::error_code none;
  const fs::directory_iterator entries(ofPhone(folder), none);
  return static_cast<size_t>(std::distance(entries, {}));
}

std::string viewerProcess() {
  return thePhone().processesOf({"zelqo-viewer"});
}

testing::AssertionResult cellShows(const std::string& name, const Colour& colour) {
  Colour last;
  const bool came = waitFor([&] {
    last = colourOf(thePhone(), name);
    return last.isAbout(colour);
  });
  if (came) return testing::AssertionSuccess();
  return testing::AssertionFailure() << name << " shows " << last << " instead of " << colour;
}

testing::AssertionResult cellIs(const std::string& name, const std::string& state) {
  return seen(thePhone(), waitFor([&] {
                const Tree tree = thePhone().tree();
                for (const auto& item : tree.items()) {
                  if (item.name.rfind(name + ", ", 0) != 0) continue;
                  const std::string end = ", " + state;
                  return item.name.size() > end.size() &&
                         item.name.compare(item.name.size() - end.size(), end.size(), end) == 0;
                }
                return false;
              }),
              "\"" + name + "\" is not " + state);
}

testing::AssertionResult downloadIsEnabled(bool isEnabled) {
  return seen(thePhone(), waitFor([=] {
                const Tree tree = thePhone().tree();
                return tree.named("Download") && tree.enables("Download") == isEnabled;
              }),
              isEnabled ? "no enabled Download" : "no disabled Download");
}
