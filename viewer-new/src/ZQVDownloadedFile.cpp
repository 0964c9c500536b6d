#include "ZQVDownloadedFile.h"

#include <Ecore_File.h>
#include <app_preference.h>
#include <fcntl.h>
#include <gio/gio.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstring>

#include "ZQVCommon.h"
#include "ZQVLog.h"
#include "ZQVOwned.h"
#include "ZQVSharedFiles.h"
#include "ZQVThumbItem.h"

namespace {

constexpr size_t kLongestPath = 512;
constexpr const char* kFolder = ZQV_DOWNLOAD_DIR "/";

/// A sender chooses the name: it must not lead out of the folder.
bool isPlainName(const char* name) {
  return name && *name && !strchr(name, '/') && strcmp(name, ".") != 0 && strcmp(name, "..") != 0;
}

bool isInFolder(const char* path) {
  return g_str_has_prefix(path, kFolder) && isPlainName(path + strlen(kFolder));
}

/// The recorded path, or nothing when there is none or it leads elsewhere.
std::string recordedPath(const ZQViewerThumbnailItem& item) {
  if (!item.downloadUrl) return {};
  const ZQVOwnedText path = ZQVSharedFiles::getInstance().pathOf(item.downloadUrl);
  return path && isInFolder(path.get()) ? path.get() : std::string();
}

std::string namedPath(const ZQViewerThumbnailItem& item) {
  if (!isPlainName(item.fileName)) return {};
  std::string path = std::string(kFolder) + item.fileName;
  if (path.size() > kLongestPath) path.resize(kLongestPath);
  return path;
}

bool isMarkedDownloaded(const char* url) {
  ZQVPlatformText value;
  return preference_get_string(url, value.out()) == PREFERENCE_ERROR_NONE &&
         g_strcmp0(value.get(), url) == 0;
}

/// Would this phone run such a file rather than show it?
bool isRunnable(const char* type) {
  static const char* const kRunnable[] = {"application/x-executable",
                                          "application/x-sharedlib",
                                          "application/x-desktop",
                                          "application/x-mimearchive-desktop",
                                          "application/x-shellscript",
                                          "application/x-perl",
                                          "text/x-python",
                                          "application/x-ruby",
                                          "application/x-awk",
                                          "application/x-ms-dos-executable"};
  for (const char* runnable : kRunnable) {
    if (g_content_type_is_a(type, runnable)) return true;
  }
  return false;
}

/// A desktop entry begins with its group, after blank lines and comments.
bool isDesktopEntry(const char* text, const char* end) {
  while (text < end && (*text == '#' || g_ascii_isspace(*text))) {
    const void* lineEnd = *text == '#' ? memchr(text, '\n', end - text) : text;
    if (!lineEnd) return false;
    text = static_cast<const char*>(lineEnd) + 1;
  }
  constexpr char kGroup[] = "[Desktop Entry]";
  return end - text >= static_cast<ptrdiff_t>(sizeof kGroup - 1) &&
         memcmp(text, kGroup, sizeof kGroup - 1) == 0;
}

bool hasRunnableContent(int fd, const char* path) {
  guchar head[4096];
  const ssize_t size = pread(fd, head, sizeof head, 0);
  if (size < 0) return true;
  if (size >= 2 && head[0] == '#' && head[1] == '!') return true;
  if (size >= 4 && memcmp(head, "\177ELF", 4) == 0) return true;
  const gsize length = static_cast<gsize>(size);
  const char* text = reinterpret_cast<const char*>(head);
  if (isDesktopEntry(text, text + size)) return true;
  ZQVOwnedText byContent(g_content_type_guess(nullptr, head, length, nullptr));
  ZQVOwnedText byName(g_content_type_guess(path, nullptr, 0, nullptr));
  return isRunnable(byContent.get()) || isRunnable(byName.get());
}

}  // namespace

std::string zqvDownloadedPath(const ZQViewerThumbnailItem& item) {
  std::string path = recordedPath(item);
  return path.empty() ? namedPath(item) : path;
}

bool zqvIsDownloadedByName(const ZQViewerThumbnailItem& item) {
  if (!item.downloadUrl) return false;
  const std::string named = namedPath(item);
  return !named.empty() && ecore_file_exists(named.c_str()) && isMarkedDownloaded(item.downloadUrl);
}

bool zqvIsDownloaded(const ZQViewerThumbnailItem& item) {
  if (!item.downloadUrl) return false;
  const std::string recorded = recordedPath(item);
  return recorded.empty() ? zqvIsDownloadedByName(item) : ecore_file_exists(recorded.c_str());
}

bool zqvMayBeOpened(const char* path) {
  const int fd = open(path, O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOFOLLOW);
  struct stat info = {};
  const char* reason = nullptr;
  if (fd < 0 || fstat(fd, &info) != 0) {
    reason = "it cannot be read";
  } else if (!S_ISREG(info.st_mode)) {
    reason = "it is no regular file";
  } else if (info.st_mode & (S_IXUSR | S_IXGRP | S_IXOTH)) {
    reason = "it is executable";
  } else if (hasRunnableContent(fd, path)) {
    reason = "it would be run instead of shown";
  }
  if (fd >= 0) close(fd);
  if (reason) ZQV_ERROR("[%s] is not opened: %s", path, reason);
  return !reason;
}
