#include "FileType.h"

#include <common/Owned.h>

#include <array>
#include <cstdio>
#include <utility>

namespace zelqo {
namespace {

constexpr std::size_t kHead = 4096;

// What the database takes for something else than what phones make of these names.
constexpr std::array<std::pair<const char*, const char*>, 2> kOverrides = {
    {{".ts", "video/mp2t"}, {".3ga", "audio/3gpp"}}};

std::string mimeOf(const char* name, const std::string& head) {
  const common::OwnedText content(g_content_type_guess(
      name, reinterpret_cast<const guchar*>(head.empty() ? nullptr : head.data()), head.size(),
      nullptr));
  const common::OwnedText mime(g_content_type_get_mime_type(content.get()));
  return mime ? mime.get() : "application/octet-stream";
}

std::string headOf(const std::string& path) {
  std::string head(kHead, '\0');
  const common::Owned<FILE, fclose> file(fopen(path.c_str(), "rbe"));
  head.resize(file ? fread(head.data(), 1, head.size(), file.get()) : 0);
  return head;
}

}  // namespace

std::string fileType(const std::string& path) {
  const common::OwnedText name(g_path_get_basename(path.c_str()));
  const common::OwnedText lower(g_ascii_strdown(name.get(), -1));
  for (const auto& [suffix, type] : kOverrides) {
    if (g_str_has_suffix(lower.get(), suffix)) return type;
  }
  const std::string type = mimeOf(lower.get(), "");
  return type == "application/octet-stream" ? mimeOf(lower.get(), headOf(path)) : type;
}

}  // namespace zelqo
