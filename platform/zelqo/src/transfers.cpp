#include "transfers.h"

#include <base/Fault.h>
#include <common/Owned.h>
#include <dlfcn.h>
#include <glib.h>

namespace {

constexpr const char* kLibrary = "libzelqo-transfer.so.1";

/// It lies beside this one. A bare name would be looked for where the sanitizers' library says when
/// that stands between.
void* openLibrary() {
  Dl_info self{};
  if (!dladdr(&kLibrary, &self)) return nullptr;
  const common::OwnedText folder(g_path_get_dirname(self.dli_fname));
  const common::OwnedText path(g_build_filename(folder.get(), kLibrary, nullptr));
  return dlopen(path.get(), RTLD_NOW | RTLD_LOCAL);
}

/// Null, with a log line, when the library is not there.
template <typename Call>
Call* find(const char* name) {
  static void* const library = openLibrary();
  void* const call = library ? dlsym(library, name) : nullptr;
  if (!call) g_warning("zelqo: nothing can be transferred: %s", dlerror());
  return reinterpret_cast<Call*>(call);
}

}  // namespace

int zelqo_request_download(const char** urls, unsigned int count, const char* folder, int priority,
                           int flags, zelqo_download_cb callback, void* user_data) {
  if (base::strikes(__func__)) return ZELQO_ERROR_STORE;
  auto* const download = find<decltype(zelqo_transfer_download)>("zelqo_transfer_download");
  return download ? download(urls, count, folder, priority, flags, callback, user_data)
                  : ZELQO_ERROR_NETWORK;
}

int zelqo_recall_upload(unsigned int request_id, zelqo_recall_cb callback, void* user_data) {
  if (base::strikes(__func__)) return ZELQO_ERROR_STORE;
  auto* const recall = find<decltype(zelqo_transfer_recall)>("zelqo_transfer_recall");
  return recall ? recall(request_id, callback, user_data) : ZELQO_ERROR_NETWORK;
}
