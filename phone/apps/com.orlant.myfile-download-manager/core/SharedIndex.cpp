#include "SharedIndex.h"

#include <common/Json.h>
#include <common/Owned.h>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>

namespace downloads {
namespace {

constexpr int kLockTries = 200;
constexpr gulong kLockPauseUs = 10000;

/// Some ten thousand entries; whoever reads the index takes no longer one.
constexpr off_t kLargestFile = 8 << 20;

using common::JsonTree;

// Kept in a file of its own: the index itself is replaced on every change.
class WriterLock {
 public:
  explicit WriterLock(const std::string& file)
      : _fd(::open((file + ".lock").c_str(), O_RDWR | O_CREAT | O_CLOEXEC | O_NOFOLLOW, 0644)) {
    for (int i = 0; _fd >= 0 && !_held && i < kLockTries; i++) {
      _held = flock(_fd, LOCK_EX | LOCK_NB) == 0;
      if (!_held) g_usleep(kLockPauseUs);
    }
  }
  ~WriterLock() {
    if (_fd >= 0) ::close(_fd);
  }
  WriterLock(const WriterLock&) = delete;
  WriterLock& operator=(const WriterLock&) = delete;

  bool isHeld() const { return _held; }

 private:
  int _fd;
  bool _held = false;
};

/// Others may write here, too: what is no regular file could keep its reader waiting.
bool isReadable(const std::string& file) {
  struct stat info {};
  return stat(file.c_str(), &info) == 0 && S_ISREG(info.st_mode) && info.st_size <= kLargestFile;
}

/// Null when there is no file or no object in it.
JsonTree readObject(const std::string& file) {
  gchar* raw = nullptr;
  gsize length = 0;
  if (!isReadable(file) || !g_file_get_contents(file.c_str(), &raw, &length, nullptr)) {
    return nullptr;
  }
  const common::OwnedText text(raw);
  return common::parseJsonObject({raw, length});
}

JsonTree withMember(const JsonTree& old, const std::string& url, const std::string& path) {
  JsonObject* object = json_object_new();
  if (old) {
    json_object_foreach_member(
        json_node_get_object(old.get()),
        [](JsonObject*, const gchar* name, JsonNode* value, gpointer copy) {
          json_object_set_member(static_cast<JsonObject*>(copy), name, json_node_copy(value));
        },
        object);
  }
  json_object_set_string_member(object, url.c_str(), path.c_str());
  JsonTree root(json_node_new(JSON_NODE_OBJECT));
  json_node_take_object(root.get(), object);
  return root;
}

}  // namespace

SharedIndex::SharedIndex(std::string file) : _file(std::move(file)) {}

std::optional<std::string> SharedIndex::find(const std::string& url) const {
  const auto root = readObject(_file);
  if (!root) return {};
  JsonNode* member = json_object_get_member(json_node_get_object(root.get()), url.c_str());
  if (!member || json_node_get_value_type(member) != G_TYPE_STRING) return {};
  return json_node_get_string(member);
}

bool SharedIndex::set(const std::string& url, const std::string& path) {
  std::error_code ignored;
  std::filesystem::create_directories(std::filesystem::path(_file).parent_path(), ignored);
  const WriterLock lock(_file);
  if (!lock.isHeld()) {
    g_warning("downloads: %s is locked by somebody else", _file.c_str());
    return false;
  }
  const auto root = withMember(readObject(_file), url, path);
  const common::OwnedText text(json_to_string(root.get(), TRUE));
  GError* error = nullptr;
  if (g_file_set_contents_full(_file.c_str(), text.get(), -1, G_FILE_SET_CONTENTS_CONSISTENT, 0644,
                               &error)) {
    return true;
  }
  g_warning("downloads: %s", error->message);
  g_error_free(error);
  return false;
}

}  // namespace downloads
