// What other processes wrote into the viewer's preferences, and what the service says of a file
// whose pictures they are: twelve texts, each ended by a zero byte.

#include "Require.h"
#include "Texts.h"
#include "ZQVDownloadedFile.h"
#include "ZQVPictureGate.h"
#include "ZQVThumbItem.h"
#include "ZQVThumbnailFetcher.h"

#include <Ecore.h>
#include <app_preference.h>
#include <string.h>

#include <map>

namespace {

std::vector<std::string> texts;
std::map<std::string, std::string> preferences;
zelqo_download_cb arrived = nullptr;
void* fetcher = nullptr;

enum Meaning {
  Address,
  Type,
  Name,
  Thumb,
  Mid,
  Token,
  AtAddress,
  AtThumb,
  AtMid,
  AtToken,
  File,
  Files,
  Count
};

bool exists(const char* path) {
  return texts[Files].find(path) != std::string::npos;
}

int answer(const std::string& text, char** out) {
  *out = strdup(text.c_str());
  return 0;
}

}  // namespace

// The preferences are a table, the service's answers are the input's, and a file is there when the
// last text names it.
int preference_get_string(const char* key, char** value) {
  const auto found = preferences.find(key);
  return found == preferences.end() ? PREFERENCE_ERROR_NO_KEY : answer(found->second, value);
}
int preference_is_existing(const char* key, bool* existing) {
  *existing = preferences.count(key) == 1;
  return 0;
}
int preference_set_string(const char* key, const char* value) {
  preferences[key] = value;
  return 0;
}
int preference_remove(const char* key) {
  preferences.erase(key);
  return 0;
}
int zelqo_content_info_get_download_url(zelqo_share_h, unsigned int, char** url) {
  return answer(texts[Address], url);
}
int zelqo_content_info_get_content_type(zelqo_share_h, unsigned int, char** type) {
  return answer(texts[Type], type);
}
int zelqo_request_download(const char**, unsigned int, const char*, int, int,
                           zelqo_download_cb callback, void* data) {
  arrived = callback;
  fetcher = data;
  return 0;
}
extern "C" Eina_Bool ecore_file_exists(const char* path) {
  return exists(path);
}
extern "C" Eina_Bool ecore_file_mkdir(const char*) {
  return EINA_TRUE;
}
extern "C" Eina_Bool ecore_file_can_write(const char*) {
  return EINA_TRUE;
}

namespace {

void arrive(const std::string& url) {
  if (arrived) arrived(1, 0, texts[File].c_str(), url.c_str(), 0, fetcher);
}

void look(const ZQViewerThumbnailItem& item) {
  require(item.thumbPath && item.largePath);
  ZQVPictureGate::passes(item.thumbPath, ZQVPictureGate::Thumbnail);
  ZQVPictureGate::passes(item.largePath, ZQVPictureGate::FullView);
  zqvIsDownloaded(item);
  const std::string path = zqvDownloadedPath(item);
  const std::string folder = "/opt/usr/media/Downloads/";
  require(path.empty() || (path.compare(0, folder.size(), folder) == 0 &&
                           path.find('/', folder.size()) == std::string::npos));
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  static const int ready = ecore_init();
  require(ready > 0);
  texts = textsOf(data, size, '\0', Count);
  preferences = {{texts[Address], texts[AtAddress]},
                 {texts[Thumb], texts[AtThumb]},
                 {texts[Mid], texts[AtMid]},
                 {texts[Token], texts[AtToken]}};
  ZQViewerThumbnailItem item;
  item.index = 0;
  item.fileName = g_strdup(texts[Name].c_str());
  item.mimeType = g_strdup(texts[Type].c_str());
  item.thumbUrl = g_strdup(texts[Thumb].c_str());
  item.midThumbUrl = g_strdup(texts[Mid].c_str());
  item.thumbPath = g_strdup("");
  item.largePath = g_strdup("");
  Eina_List* items = eina_list_append(nullptr, &item);
  {
    ZQVThumbnailFetcher thumbnails;
    auto* share = reinterpret_cast<zelqo_share_h>(1);
    thumbnails.setShare(items, texts[Token].c_str());
    thumbnails._getContentInfoNReqNormalThumbnail(share);
    arrive(texts[Thumb]);
    thumbnails._reqMidThumbnail(share);
    arrive(texts[Mid]);
    look(item);
  }
  arrived = nullptr;
  eina_list_free(items);
  return 0;
}
