// A launch request, which any application may send: as bytes of a bundle, or written down like the
// words of `phone launch raw`, one KEY=VALUE or KEY[]=VALUE to a line.

#include "DownloadRequest.h"
#include "Require.h"
#include "Texts.h"
#include "ZQVLaunchRequest.h"
#include "ZQVLocalList.h"
#include "ZQVThumbItem.h"

#include <app_control_internal.h>
#include <bundle.h>
#include <media_content.h>

#include <map>
#include <string>
#include <vector>

// The files are looked up in no database: whoever asks one waits for another process.
int media_content_connect() {
  return MEDIA_CONTENT_ERROR_DB_FAILED;
}

namespace {

ZQVOwnedBundle written(const uint8_t* data, size_t size) {
  ZQVOwnedBundle contents(bundle_create());
  std::map<std::string, std::vector<const char*>> arrays;
  const auto lines = textsOf(data, size, '\n');
  for (const auto& line : lines) {
    const size_t equals = line.find('=');
    if (equals == std::string::npos) continue;
    const std::string key = line.substr(0, equals);
    const char* value = line.c_str() + equals + 1;
    if (key.size() > 2 && key.compare(key.size() - 2, 2, "[]") == 0) {
      arrays[key.substr(0, key.size() - 2)].push_back(value);
    } else {
      bundle_add_str(contents.get(), key.c_str(), value);
    }
  }
  for (auto& [key, values] : arrays) {
    bundle_add_str_array(contents.get(), key.c_str(), values.data(),
                         static_cast<int>(values.size()));
  }
  return contents;
}

/// The bundle after a journey between two processes.
ZQVOwnedBundle sent(const ZQVOwnedBundle& contents) {
  ZQVOwned<bundle_raw, free> raw;
  int length = 0;
  require(bundle_encode(contents.get(), raw.out(), &length) == BUNDLE_ERROR_NONE);
  ZQVOwnedBundle arrived(bundle_decode(raw.get(), length));
  require(arrived && bundle_get_count(arrived.get()) <= bundle_get_count(contents.get()));
  return arrived;
}

void readByViewer(app_control_h request) {
  ZQVLaunchRequest::isForViewer(request);
  const ZQVLaunchRequest launch(request);
  launch.isSingleShare();
  launch.requestId();
  const auto files = launch.files();
  std::vector<const char*> paths;
  paths.reserve(files.size());
  for (const auto& file : files) paths.push_back(file.get());
  Eina_List* items = nullptr;
  uint64_t totalSize = 0;
  ZQVLocalList::append(paths.data(), static_cast<int>(paths.size()), &items, &totalSize);
  void* item = nullptr;
  EINA_LIST_FREE(items, item) delete static_cast<ZQViewerThumbnailItem*>(item);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  static const int ready = eina_init();
  require(ready > 0);
  ZQVOwnedBundle contents(bundle_decode(data, static_cast<int>(size)));
  if (!contents) contents = written(data, size);
  const ZQVOwnedBundle arrived = sent(contents);
  ZQVOwnedAppControl request;
  require(app_control_create_event(arrived.get(), request.out()) == APP_CONTROL_ERROR_NONE);
  readByViewer(request.get());
  downloads::readRequest(request.get());
  return 0;
}
