#include <sys/stat.h>
#include <unistd.h>

#include <utility>

#include "DownloadThread.h"
#include "transfers.h"

namespace {

bool isWritableFolder(const char* path) {
  struct stat status;
  return path && path[0] == '/' && stat(path, &status) == 0 && S_ISDIR(status.st_mode) &&
         access(path, W_OK | X_OK) == 0;
}

std::string withoutTrailingSlash(std::string folder) {
  while (folder.size() > 1 && folder.back() == '/') folder.pop_back();
  return folder;
}

}  // namespace

int zelqo_transfer_download(const char** urls, unsigned int count, const char* folder, int priority,
                            int flags, zelqo_download_cb callback, void* user_data) {
  if (!urls || count == 0 || priority < 0 || flags != 0 || !callback) {
    return ZELQO_ERROR_INVALID_PARAMETER;
  }
  zelqo::Downloader::Order order;
  for (unsigned int i = 0; i < count; i++) {
    if (!urls[i]) return ZELQO_ERROR_INVALID_PARAMETER;
    order.urls.emplace_back(urls[i]);
  }
  if (!isWritableFolder(folder)) return ZELQO_ERROR_STORE;
  order.folder = withoutTrailingSlash(folder);
  order.report = [callback, user_data](const zelqo::Downloader::Report& report) {
    callback(report.requestId, report.error, report.path.empty() ? nullptr : report.path.c_str(),
             report.url.c_str(), report.remaining, user_data);
  };
  zelqo::DownloadThread* const thread = zelqo::DownloadThread::instance();
  if (!thread) return ZELQO_ERROR_NETWORK;
  thread->add(std::move(order));
  return ZELQO_ERROR_NONE;
}
