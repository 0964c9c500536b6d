#include "BlobStore.h"

#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <utility>

#include "Owned.h"
#include "Secrets.h"

namespace service {
namespace {

constexpr mode_t kPrivate = 0700;
constexpr std::array<const char*, 4> kWords = {"file", "thumb", "mid", "big"};

using Folder = Owned<DIR, closedir>;

bool makeFolder(const std::string& path) {
  if (g_mkdir_with_parents(path.c_str(), kPrivate) == 0) return true;
  g_warning("storage: cannot make %s: %s", path.c_str(), g_strerror(errno));
  return false;
}

// Only folders of the service's own making, so at most two levels deep; links are not followed.
void removeTree(int parent, const char* name) {
  const int fd = openat(parent, name, O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC);
  if (fd >= 0) {
    const Folder folder(fdopendir(fd));
    while (const dirent* entry = folder ? readdir(folder.get()) : nullptr) {
      if (strcmp(entry->d_name, ".") == 0 || strcmp(entry->d_name, "..") == 0) continue;
      if (unlinkat(fd, entry->d_name, 0) != 0) removeTree(fd, entry->d_name);
    }
  }
  unlinkat(parent, name, AT_REMOVEDIR);
}

void removeInThread(GTask* task, gpointer, gpointer data, GCancellable*) {
  removeTree(AT_FDCWD, static_cast<const char*>(data));
  g_task_return_boolean(task, TRUE);
}

void removeInBackground(const std::string& folder) {
  const Ref<GTask> task(g_task_new(nullptr, nullptr, nullptr, nullptr));
  g_task_set_task_data(task.get(), g_strdup(folder.c_str()), g_free);
  g_task_run_in_thread(task.get(), removeInThread);
}

}  // namespace

const char* blobWord(BlobKind kind) {
  return kWords[static_cast<std::size_t>(kind)];
}

std::optional<BlobKind> blobKind(const std::string& word) {
  for (std::size_t i = 0; i < kWords.size(); i++) {
    if (word == kWords[i]) return static_cast<BlobKind>(i);
  }
  return std::nullopt;
}

BlobStore::BlobStore(std::string root) : _root(std::move(root)) {}

bool BlobStore::open() {
  if (!makeFolder(_root + "/trash")) return false;
  discard(incoming());
  emptyTrash();
  return makeFolder(_root + "/share") && makeFolder(_root + "/staging") && makeFolder(incoming());
}

std::string BlobStore::shareFolder(const std::string& token) const {
  return _root + "/share/" + token;
}

std::string BlobStore::stagingFolder(std::int64_t id) const {
  return _root + "/staging/" + std::to_string(id);
}

std::string BlobStore::publishedManifest(const std::string& token) const {
  return shareFolder(token) + "/manifest.json";
}

std::string BlobStore::published(const std::string& token, BlobKind kind,
                                 std::int64_t index) const {
  return shareFolder(token) + "/" + blobWord(kind) + "/" + std::to_string(index);
}

std::string BlobStore::staged(std::int64_t id, BlobKind kind, std::int64_t index) const {
  return stagingFolder(id) + "/" + blobWord(kind) + "/" + std::to_string(index);
}

std::optional<std::int64_t> BlobStore::stagedSize(std::int64_t id, BlobKind kind,
                                                  std::int64_t index) const {
  struct stat status;
  if (stat(staged(id, kind, index).c_str(), &status) != 0) return std::nullopt;
  return status.st_size;
}

bool BlobStore::makeStaging(std::int64_t id) const {
  for (const char* word : kWords) {
    if (!makeFolder(stagingFolder(id) + "/" + word)) return false;
  }
  return true;
}

bool BlobStore::publish(std::int64_t id, const std::string& token,
                        const std::string& manifest) const {
  const std::string file = stagingFolder(id) + "/manifest.json";
  ErrorOut error;
  if (!g_file_set_contents(file.c_str(), manifest.data(), static_cast<gssize>(manifest.size()),
                           error)) {
    g_warning("storage: %s", error.message());
    return false;
  }
  if (rename(stagingFolder(id).c_str(), shareFolder(token).c_str()) == 0) return true;
  g_warning("storage: cannot publish share %" G_GINT64_FORMAT ": %s", id, g_strerror(errno));
  return false;
}

void BlobStore::withdraw(std::int64_t id, const std::string& token) const {
  discard(shareFolder(token));
  discard(stagingFolder(id));
}

// What an earlier run had no time to remove.
void BlobStore::emptyTrash() const {
  const std::string trash = _root + "/trash/";
  const Folder folder(opendir(trash.c_str()));
  while (const dirent* entry = folder ? readdir(folder.get()) : nullptr) {
    if (entry->d_name[0] != '.') removeInBackground(trash + entry->d_name);
  }
}

void BlobStore::discard(const std::string& folder) const {
  const std::string grave = _root + "/trash/" + randomHex(8);
  if (rename(folder.c_str(), grave.c_str()) == 0) {
    removeInBackground(grave);
  } else if (errno != ENOENT) {
    // The last part may be a share's token, which lets its holder in.
    g_warning("storage: cannot remove a folder of %s: %s",
              folder.substr(0, folder.rfind('/')).c_str(), g_strerror(errno));
  }
}

}  // namespace service
