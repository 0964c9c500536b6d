// Names of files on their way through the viewer: into what is shown of them, and over to the
// download application. A name to each text, each ended by a zero byte.

#include "DownloadRequest.h"
#include "Require.h"
#include "Texts.h"
#include "ZQVAccess.h"
#include "ZQVDownloadMgr.h"
#include "ZQVMarkup.h"
#include "ZQVOwned.h"
#include "ZQVThumbItem.h"

#include <Evas.h>
#include <app_control_internal.h>
#include <orlant_log_manager.h>

#include <memory>
#include <vector>

namespace {

std::vector<downloads::Download> wanted;

}  // namespace

// What would be launched is read as the download application reads it; usage is not recorded.
int app_control_send_launch_request(app_control_h request, app_control_reply_cb, void*) {
  ZQVOwnedBundle contents;
  require(app_control_export_as_bundle(request, contents.out()) == APP_CONTROL_ERROR_NONE);
  ZQVOwned<bundle_raw, free> raw;
  int length = 0;
  require(bundle_encode(contents.get(), raw.out(), &length) == BUNDLE_ERROR_NONE);
  const ZQVOwnedBundle arrived(bundle_decode(raw.get(), length));
  ZQVOwnedAppControl event;
  require(app_control_create_event(arrived.get(), event.out()) == APP_CONTROL_ERROR_NONE);
  wanted = downloads::readRequest(event.get());
  return APP_CONTROL_ERROR_NONE;
}
int orlant_log_manager_create(orlant_log_manager_h*) {
  return ORLANT_LOG_ERROR_STORE;
}
int orlant_log_manager_insert(orlant_log_manager_h, const char*, bundle*,
                              orlant_log_manager_reply_cb, void*, int*) {
  return ORLANT_LOG_ERROR_STORE;
}

namespace {

std::string valid(const std::string& text) {
  const ZQVOwnedText result(g_utf8_make_valid(text.c_str(), -1));
  return result.get();
}

/// The files as the select page has them, all checked.
class Files {
 public:
  explicit Files(const std::vector<std::string>& names) {
    for (const auto& name : names) {
      auto item = std::make_unique<ZQViewerThumbnailItem>();
      item->fileName = g_strdup(name.c_str());
      item->fileSize = static_cast<uint32_t>(name.size() << 20);
      item->mimeType = g_strdup(name.c_str());
      item->downloadUrl = g_strdup_printf("http://service/%zu", _items.size());
      item->checked = true;
      _list = eina_list_append(_list, item.get());
      _items.push_back(std::move(item));
    }
  }
  ~Files() { eina_list_free(_list); }
  Files(const Files&) = delete;
  Files& operator=(const Files&) = delete;

  Eina_List* list() const { return _list; }
  const ZQViewerThumbnailItem& operator[](size_t i) const { return *_items[i]; }

 private:
  Eina_List* _list = nullptr;
  std::vector<std::unique_ptr<ZQViewerThumbnailItem>> _items;
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  static const int ready = evas_init();
  require(ready > 0);
  const auto names = textsOf(data, size, '\0');
  const Files files(names);
  for (size_t i = 0; i < names.size(); ++i) {
    require(g_utf8_validate(zqvCellName(files[i]).c_str(), -1, nullptr));
  }
  wanted.clear();
  ZQVDownloadMgr(files.list(), false, 1, names[0].c_str(), "token")._downloadMgrCreate();
  require(wanted.size() == names.size());
  for (size_t i = 0; i < names.size(); ++i) {
    require(wanted[i].name == valid(names[i]));
    require(files[i].downloadStatus == ZQV_REQUESTED);
  }
  return 0;
}
