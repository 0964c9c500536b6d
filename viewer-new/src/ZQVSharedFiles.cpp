#include "ZQVSharedFiles.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>

#include "ZQVLog.h"

namespace {

/// Some ten thousand entries; anything larger is not what the file manager writes.
constexpr off_t kLargestFile = 8 << 20;
/// One object of texts needs a depth of 1. The parser recurses, so depth has to be bounded before.
constexpr int kDeepestNesting = 32;

bool isSameFile(const struct stat& a, const struct stat& b) {
  return a.st_ino == b.st_ino && a.st_dev == b.st_dev && a.st_size == b.st_size &&
         a.st_mtim.tv_sec == b.st_mtim.tv_sec && a.st_mtim.tv_nsec == b.st_mtim.tv_nsec;
}

/// The number of an escaped character; -1 when there is something else.
int escapedCharacter(const std::string& json, size_t at) {
  if (at + 5 >= json.size() || json[at] != '\\' || json[at + 1] != 'u') return -1;
  int number = 0;
  for (size_t i = at + 2; i < at + 6; ++i) {
    const int digit = g_ascii_xdigit_value(json[i]);
    if (digit < 0) return -1;
    number = number * 16 + digit;
  }
  return number;
}

/// The length of an escape; 0 for a broken one or half a pair, over which the parser would forget
/// to free the whole text.
size_t lengthOfEscape(const std::string& json, size_t at) {
  if (json.compare(at, 2, "\\u") != 0) return 2;
  const int number = escapedCharacter(json, at);
  if (number < 0) return 0;
  if (number >> 11 != 0xd800 >> 11) return 6;
  const bool pair = number < 0xdc00 && escapedCharacter(json, at + 6) >> 10 == 0xdc00 >> 10;
  return pair ? 12 : 0;
}

/// The index of the quote that ends the text starting behind `start`; 0 for a broken text.
size_t endOfText(const std::string& json, size_t start) {
  size_t at = start + 1;
  while (at < json.size() && json[at] != '"') {
    const size_t length = json[at] == '\\' ? lengthOfEscape(json, at) : 1;
    if (length == 0) return 0;
    at += length;
  }
  return at;
}

/// Can the parser be trusted with it? It recurses as deep as the brackets go, and accepts comments
/// and single quotes, which could hide brackets from this look.
bool isHarmless(const std::string& json) {
  int depth = 0;
  for (size_t at = 0; at < json.size(); ++at) {
    const char c = json[at];
    if (c == '"' && (at = endOfText(json, at)) == 0) return false;
    if (c == '/' || c == '#' || c == '\'') return false;
    if (c == '[' || c == '{') ++depth;
    if (c == ']' || c == '}') --depth;
    if (depth > kDeepestNesting || depth < 0) return false;
  }
  return true;
}

bool readAll(int fd, std::string* text) {
  char chunk[65536];
  ssize_t count = 0;
  while ((count = read(fd, chunk, sizeof chunk)) > 0) {
    text->append(chunk, static_cast<size_t>(count));
    if (text->size() > static_cast<size_t>(kLargestFile)) return false;
  }
  return count == 0;
}

}  // namespace

ZQVSharedFiles::ZQVSharedFiles(const char* file) : _file(file) {}

ZQVSharedFiles& ZQVSharedFiles::getInstance() {
  static ZQVSharedFiles instance;
  return instance;
}

ZQVOwnedText ZQVSharedFiles::pathOf(const char* url) {
  if (!url) {
    ZQV_ERROR("url is NULL");
    return nullptr;
  }
  _refresh();
  if (_error) {
    ZQV_ERROR("gRet is %d", _error);
    return nullptr;
  }
  if (!_root || !JSON_NODE_HOLDS_OBJECT(_root.get())) {
    ZQV_ERROR("root is NULL");
    return nullptr;
  }
  JsonNode* member = json_object_get_member(json_node_get_object(_root.get()), url);
  const char* path =
      member && JSON_NODE_HOLDS_VALUE(member) ? json_node_get_string(member) : nullptr;
  if (!path) {
    ZQV_ERROR("fullpath is NULL");
    return nullptr;
  }
  return ZQVOwnedText(g_strdup(path));
}

void ZQVSharedFiles::_refresh() {
  // Not blocking: something other than a file under this name must not hold up the main loop.
  const int fd = open(_file.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
  struct stat now = {};
  if (fd < 0 || fstat(fd, &now) != 0) {
    _root.reset();
    _stamp = {};
    _error = g_file_error_from_errno(errno);
  } else if (!isSameFile(now, _stamp)) {
    _root.reset();
    _stamp = now;
    _error = _load(fd);
  }
  if (fd >= 0) close(fd);
}

int ZQVSharedFiles::_load(int fd) {
  if (!S_ISREG(_stamp.st_mode) || _stamp.st_size > kLargestFile) {
    ZQV_ERROR("%s is not a list of files: mode %o, %jd bytes", _file.c_str(),
              static_cast<unsigned>(_stamp.st_mode), static_cast<intmax_t>(_stamp.st_size));
    return G_FILE_ERROR_INVAL;
  }
  std::string text;
  if (!readAll(fd, &text)) return G_FILE_ERROR_IO;
  return _parse(text);
}

int ZQVSharedFiles::_parse(const std::string& text) {
  if (!isHarmless(text)) return G_FILE_ERROR_INVAL;
  // Of several documents in a row the parser gives the last and never frees the others. Between
  // brackets there can be only one.
  const std::string bracketed = "[" + text + "]";
  ZQVOwned<JsonParser, g_object_unref> parser(json_parser_new_immutable());
  GError* error = nullptr;
  if (!json_parser_load_from_data(parser.get(), bracketed.data(),
                                  static_cast<gssize>(bracketed.size()), &error)) {
    // The parser's own numbers start at 0, which stands for success here.
    const int code = error && error->code ? error->code : G_FILE_ERROR_FAILED;
    g_clear_error(&error);
    return code;
  }
  JsonArray* documents = json_node_get_array(json_parser_get_root(parser.get()));
  if (json_array_get_length(documents) > 1) return G_FILE_ERROR_INVAL;
  if (json_array_get_length(documents) == 1) {
    _root.reset(json_node_copy(json_array_get_element(documents, 0)));
  }
  return 0;
}
