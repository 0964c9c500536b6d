#pragma once

#include <json-glib/json-glib.h>
#include <sys/stat.h>

#include <string>

#include "ZQVOwned.h"

/// Where the file manager records what it has downloaded.
#define ZQV_SHARED_FILES_PATH "/opt/usr/apps/com.orlant.myfile-lite/shared/data/zelqo/zelqo.json"

/// What the file manager says about downloaded files: one JSON object, download address to full
/// local path. Read again only when the file has changed, so asking for every file of a share is
/// cheap.
class ZQVSharedFiles {
 public:
  explicit ZQVSharedFiles(const char* file = ZQV_SHARED_FILES_PATH);
  ZQVSharedFiles(const ZQVSharedFiles&) = delete;
  ZQVSharedFiles& operator=(const ZQVSharedFiles&) = delete;

  static ZQVSharedFiles& getInstance();

  /// The path recorded for a download address, null when there is none. Whether the file still
  /// exists is not looked at.
  ZQVOwnedText pathOf(const char* url);

 private:
  void _refresh();
  int _load(int fd);
  int _parse(const std::string& text);

  std::string _file;
  struct stat _stamp = {};
  ZQVOwned<JsonNode, json_node_unref> _root;
  int _error = 0;
};
