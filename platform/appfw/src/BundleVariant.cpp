#include "BundleVariant.h"

#include <dlog.h>

#include <unordered_set>

namespace appfw {
namespace {

GVariant* textsVariant(const keyval_t& entry) {
  GVariantBuilder texts;
  g_variant_builder_init(&texts, G_VARIANT_TYPE_STRING_ARRAY);
  for (const auto& text : entry.texts) g_variant_builder_add(&texts, "s", utf8(text).c_str());
  return g_variant_builder_end(&texts);
}

/// False when the value is no text and no text array.
bool append(bundle& target, const char* key, GVariant* value) {
  if (g_variant_is_of_type(value, G_VARIANT_TYPE_STRING)) {
    target.entries.emplace_back(key, std::string(g_variant_get_string(value, nullptr)));
    return true;
  }
  if (!g_variant_is_of_type(value, G_VARIANT_TYPE_STRING_ARRAY)) return false;
  gsize count = 0;
  common::Owned<const char*, g_free> texts(g_variant_get_strv(value, &count));
  target.entries.emplace_back(key, std::vector<std::string>(texts.get(), texts.get() + count));
  return true;
}

}  // namespace

std::string utf8(const std::string& text) {
  common::OwnedText valid(g_utf8_make_valid(text.c_str(), static_cast<gssize>(text.size())));
  return valid.get();
}

GVariant* toVariant(const bundle& contents) {
  GVariantBuilder entries;
  g_variant_builder_init(&entries, G_VARIANT_TYPE_VARDICT);
  for (const auto& entry : contents.entries) {
    GVariant* value =
        entry.isArray() ? textsVariant(entry) : g_variant_new_string(utf8(entry.text).c_str());
    g_variant_builder_add(&entries, "{sv}", utf8(entry.key).c_str(), value);
  }
  return g_variant_builder_end(&entries);
}

OwnedBundle fromVariant(GVariant* contents) {
  OwnedBundle target = emptyBundle();
  // A stranger may send keys by the ten thousand: looking each up in the list would take minutes.
  std::unordered_set<std::string> known;
  GVariantIter entries;
  g_variant_iter_init(&entries, contents);
  const char* key = nullptr;
  GVariant* value = nullptr;
  while (g_variant_iter_loop(&entries, "{&sv}", &key, &value)) {
    if (!*key || known.count(key) || !append(*target, key, value)) {
      dlog_print(DLOG_WARN, "APPFW", "bundle entry \"%s\" of type %s is left out", key,
                 g_variant_get_type_string(value));
      continue;
    }
    known.insert(key);
  }
  return target;
}

}  // namespace appfw
