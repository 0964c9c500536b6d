#include <base/Fault.h>
#include <common/Owned.h>
#include <mime_type.h>

#include <cstring>
#include <string>

namespace {

using common::OwnedText;

// Where the shared database means something else by the extension than a phone does.
struct Override {
  const char* extension;
  const char* type;
};
constexpr Override kOverrides[] = {
    {"ts", "video/mp2t"},
    {"3ga", "audio/3gpp"},
};

const char* overrideFor(const char* extension) {
  for (const auto& entry : kOverrides) {
    if (std::strcmp(entry.extension, extension) == 0) return entry.type;
  }
  return nullptr;
}

OwnedText typeOf(const char* extension) {
  const OwnedText lower(g_ascii_strdown(extension, -1));
  if (const char* type = overrideFor(lower.get())) return OwnedText(g_strdup(type));
  // A name that is not UTF-8 or holds a folder would be looked up as something else.
  if (!*extension || std::strchr(extension, '/') || !g_utf8_validate(extension, -1, nullptr)) {
    return OwnedText(g_strdup("application/octet-stream"));
  }
  const std::string name = std::string("x.") + lower.get();
  const OwnedText content(g_content_type_guess(name.c_str(), nullptr, 0, nullptr));
  return OwnedText(g_content_type_get_mime_type(content.get()));
}

}  // namespace

int mime_type_get_mime_type(const char* file_extension, char** mime_type) {
  if (base::strikes(__func__)) return MIME_TYPE_ERROR_OUT_OF_MEMORY;
  if (!file_extension || !mime_type) return MIME_TYPE_ERROR_INVALID_PARAMETER;
  const OwnedText type = typeOf(file_extension);
  *mime_type = strdup(type ? type.get() : "application/octet-stream");
  return *mime_type ? MIME_TYPE_ERROR_NONE : MIME_TYPE_ERROR_OUT_OF_MEMORY;
}
