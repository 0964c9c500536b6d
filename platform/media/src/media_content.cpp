#include <base/Fault.h>
#include <base/PhonePaths.h>
#include <media_content.h>

#include <cstring>
#include <filesystem>
#include <new>
#include <optional>
#include <string>

#include "MediaRecord.h"

namespace fs = std::filesystem;

struct filter_s {
  std::string path;
};

struct media_info_s {
  media::MediaRecord record;
};

namespace {

int connections = 0;

const char* skipBlanks(const char* text) {
  return text + std::strspn(text, " \t");
}

// The text between single quotes, doubled ones standing for one; nothing when it is not one text
// and then the end.
std::optional<std::string> quotedText(const char* text) {
  if (*text++ != '\'') return {};
  std::string value;
  for (; *text; text++) {
    if (*text != '\'') {
      value += *text;
    } else if (text[1] == '\'') {
      value += *text++;
    } else {
      return *skipBlanks(text + 1) ? std::nullopt : std::optional(value);
    }
  }
  return {};
}

std::optional<std::string> pathOfCondition(const char* condition) {
  const char* text = skipBlanks(condition);
  const std::size_t length = std::strlen(MEDIA_PATH);
  if (std::strncmp(text, MEDIA_PATH, length) != 0) return {};
  text = skipBlanks(text + length);
  if (*text != '=') return {};
  return quotedText(skipBlanks(text + 1));
}

/// False when the callback wants no more.
bool report(const std::string& path, media_info_cb callback, void* userData) {
  auto record = media::lookUp(path);
  if (!record) return true;
  media_info_s info{*std::move(record)};
  return callback(&info, userData);
}

void reportAll(media_info_cb callback, void* userData) {
  std::error_code error;
  fs::recursive_directory_iterator entry(base::phoneRoot() + "/media", error);
  for (; entry != fs::recursive_directory_iterator(); entry.increment(error)) {
    const bool hidden = entry->path().filename().native()[0] == '.';
    if (hidden) {
      entry.disable_recursion_pending();
    } else if (!report(entry->path().native(), callback, userData)) {
      return;
    }
    if (error) return;
  }
}

int copyText(media_info_h media, char** text, const std::string& value) {
  if (!media || !text) return MEDIA_CONTENT_ERROR_INVALID_PARAMETER;
  *text = value.empty() ? nullptr : strdup(value.c_str());
  return *text || value.empty() ? MEDIA_CONTENT_ERROR_NONE : MEDIA_CONTENT_ERROR_OUT_OF_MEMORY;
}

}  // namespace

int media_content_connect(void) {
  if (base::strikes(__func__)) return MEDIA_CONTENT_ERROR_DB_FAILED;
  connections++;
  return MEDIA_CONTENT_ERROR_NONE;
}

int media_content_disconnect(void) {
  if (base::strikes(__func__)) return MEDIA_CONTENT_ERROR_DB_FAILED;
  if (connections == 0) return MEDIA_CONTENT_ERROR_INVALID_OPERATION;
  connections--;
  return MEDIA_CONTENT_ERROR_NONE;
}

int media_filter_create(filter_h* filter) {
  if (base::strikes(__func__)) return MEDIA_CONTENT_ERROR_OUT_OF_MEMORY;
  if (!filter) return MEDIA_CONTENT_ERROR_INVALID_PARAMETER;
  *filter = new (std::nothrow) filter_s;
  return *filter ? MEDIA_CONTENT_ERROR_NONE : MEDIA_CONTENT_ERROR_OUT_OF_MEMORY;
}

int media_filter_destroy(filter_h filter) {
  if (!filter) return MEDIA_CONTENT_ERROR_INVALID_PARAMETER;
  delete filter;
  return MEDIA_CONTENT_ERROR_NONE;
}

// A path names one file, so the collation has nothing to choose from.
int media_filter_set_condition(filter_h filter, const char* condition,
                               media_content_collation_e /*collate_type*/) {
  if (base::strikes(__func__)) return MEDIA_CONTENT_ERROR_OUT_OF_MEMORY;
  if (!filter || !condition) return MEDIA_CONTENT_ERROR_INVALID_PARAMETER;
  auto path = pathOfCondition(condition);
  if (!path) return MEDIA_CONTENT_ERROR_INVALID_PARAMETER;
  filter->path = *std::move(path);
  return MEDIA_CONTENT_ERROR_NONE;
}

int media_info_foreach_media_from_db(filter_h filter, media_info_cb callback, void* user_data) {
  if (base::strikes(__func__)) return MEDIA_CONTENT_ERROR_DB_FAILED;
  if (!callback) return MEDIA_CONTENT_ERROR_INVALID_PARAMETER;
  if (connections == 0) return MEDIA_CONTENT_ERROR_DB_FAILED;
  if (filter) {
    report(filter->path, callback, user_data);
  } else {
    reportAll(callback, user_data);
  }
  return MEDIA_CONTENT_ERROR_NONE;
}

int media_info_clone(media_info_h* dst, media_info_h src) {
  if (base::strikes(__func__)) return MEDIA_CONTENT_ERROR_OUT_OF_MEMORY;
  if (!dst || !src) return MEDIA_CONTENT_ERROR_INVALID_PARAMETER;
  *dst = new (std::nothrow) media_info_s(*src);
  return *dst ? MEDIA_CONTENT_ERROR_NONE : MEDIA_CONTENT_ERROR_OUT_OF_MEMORY;
}

int media_info_destroy(media_info_h media) {
  if (!media) return MEDIA_CONTENT_ERROR_INVALID_PARAMETER;
  delete media;
  return MEDIA_CONTENT_ERROR_NONE;
}

int media_info_get_thumbnail_path(media_info_h media, char** path) {
  if (base::strikes(__func__)) return MEDIA_CONTENT_ERROR_OUT_OF_MEMORY;
  return copyText(media, path, media ? media->record.thumbnail : std::string());
}

int media_info_get_file_path(media_info_h media, char** path) {
  return copyText(media, path, media ? media->record.path : std::string());
}

int media_info_get_mime_type(media_info_h media, char** mime_type) {
  return copyText(media, mime_type, media ? media->record.mimeType : std::string());
}

int media_info_get_display_name(media_info_h media, char** name) {
  return copyText(media, name,
                  media ? fs::path(media->record.path).filename().native() : std::string());
}
