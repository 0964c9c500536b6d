#include "mime_handler.h"

#include <fcntl.h>
#include <gio/gio.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstring>

namespace mime {
namespace {

constexpr std::size_t kSniffBytes = 4096;

using common::OwnedText;

class File {
 public:
  explicit File(const std::string& path)
      : _fd(::open(path.c_str(), O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC)) {}
  ~File() {
    if (_fd >= 0) ::close(_fd);
  }
  File(const File&) = delete;
  File& operator=(const File&) = delete;

  bool isPlain() const {
    struct stat info {};
    constexpr mode_t kExecute = S_IXUSR | S_IXGRP | S_IXOTH;
    return _fd >= 0 && fstat(_fd, &info) == 0 && S_ISREG(info.st_mode) &&
           (info.st_mode & kExecute) == 0;
  }

  std::string beginning() const {
    std::string bytes(kSniffBytes, '\0');
    const ssize_t got = ::read(_fd, bytes.data(), bytes.size());
    bytes.resize(got > 0 ? static_cast<std::size_t>(got) : 0);
    return bytes;
  }

 private:
  int _fd;
};

bool isA(const char* type, const char* ancestor) {
  return g_content_type_is_a(type, ancestor);
}

// A type that runs when it is opened, or that a program could be talked into running.
bool isProgram(const std::string& bytes, const char* type) {
  static constexpr const char* kPrograms[] = {
      "application/x-executable",  "application/x-shellscript", "application/x-desktop",
      "application/x-sharedlib",   "application/x-msdownload",  "application/x-ms-dos-executable",
      "application/x-java-archive"};
  if (bytes.compare(0, 2, "#!") == 0) return true;
  for (const char* program : kPrograms) {
    if (isA(type, program)) return true;
  }
  return false;
}

bool isContainer(const char* type) {
  static constexpr const char* kContainers[] = {"application/zip", "application/x-ole-storage",
                                                "application/xml", "text/plain"};
  for (const char* container : kContainers) {
    if (std::strcmp(type, container) == 0) return true;
  }
  return false;
}

// What the bytes say; the name may only choose among the formats that share a container.
OwnedText typeOf(const std::string& path, const std::string& bytes) {
  const auto* data = reinterpret_cast<const guchar*>(bytes.data());
  OwnedText content(g_content_type_guess(nullptr, data, bytes.size(), nullptr));
  if (!isContainer(content.get())) return content;
  const OwnedText name(g_path_get_basename(path.c_str()));
  OwnedText named(g_content_type_guess(name.get(), nullptr, 0, nullptr));
  return isA(named.get(), content.get()) ? std::move(named) : std::move(content);
}

// A phone has no terminal to run the others in.
bool hasWindow(GAppInfo* info) {
  return !G_IS_DESKTOP_APP_INFO(info) ||
         !g_desktop_app_info_get_boolean(G_DESKTOP_APP_INFO(info), "Terminal");
}

}  // namespace

std::string openableType(const std::string& path) {
  const File file(path);
  if (!file.isPlain()) return {};
  const std::string bytes = file.beginning();
  if (bytes.empty()) return {};
  const OwnedText type = typeOf(path, bytes);
  if (g_content_type_is_unknown(type.get()) || isProgram(bytes, type.get())) return {};
  const OwnedText mimeType(g_content_type_get_mime_type(type.get()));
  return mimeType ? mimeType.get() : "";
}

OwnedAppInfo handlerFor(const std::string& path) {
  const std::string type = openableType(path);
  if (type.empty()) return nullptr;
  OwnedAppInfo preferred(g_app_info_get_default_for_type(type.c_str(), FALSE));
  if (preferred && hasWindow(preferred.get())) return preferred;
  GList* all = g_app_info_get_all_for_type(type.c_str());
  OwnedAppInfo found;
  for (GList* entry = all; entry && !found; entry = entry->next) {
    auto* info = static_cast<GAppInfo*>(entry->data);
    if (hasWindow(info)) found.reset(G_APP_INFO(g_object_ref(info)));
  }
  g_list_free_full(all, g_object_unref);
  return found;
}

std::string pathOfUri(const std::string& uri) {
  if (uri.compare(0, 1, "/") == 0) return uri;
  const OwnedText path(g_filename_from_uri(uri.c_str(), nullptr, nullptr));
  return path ? path.get() : "";
}

bool resolver_can_open(const char* uri) {
  return uri && handlerFor(pathOfUri(uri)) != nullptr;
}

}  // namespace mime
