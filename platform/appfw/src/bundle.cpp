#include "Bundle.h"
#include "BundleVariant.h"

#include <base/Fault.h>
#include <algorithm>
#include <climits>
#include <cstdlib>
#include <cstring>
#include <string_view>

namespace {

using common::OwnedVariant;

/// Tells encoded bundles from anything else. Eight bytes, for what follows must stay aligned.
constexpr std::string_view kMagic = "bundle1\n";

bool isText(const char* text) {
  return text && *text;
}

/// The entry of that key and type; otherwise null, with the reason as last result.
const keyval_t* findOfType(const bundle* b, const char* key, int type) {
  if (!b || !isText(key)) {
    set_last_result(BUNDLE_ERROR_INVALID_PARAMETER);
    return nullptr;
  }
  const keyval_t* entry = b->find(key);
  if (!entry) {
    set_last_result(BUNDLE_ERROR_KEY_NOT_AVAILABLE);
  } else if (entry->type != type) {
    set_last_result(BUNDLE_ERROR_INVALID_PARAMETER);
  } else {
    set_last_result(BUNDLE_ERROR_NONE);
  }
  return entry && entry->type == type ? entry : nullptr;
}

}  // namespace

keyval_t::keyval_t(std::string entryKey, std::string entryText)
    : key(std::move(entryKey)), type(BUNDLE_TYPE_STR), text(std::move(entryText)) {}

keyval_t::keyval_t(std::string entryKey, std::vector<std::string> entryTexts)
    : key(std::move(entryKey)), type(BUNDLE_TYPE_STR_ARRAY), texts(std::move(entryTexts)) {
  for (const auto& entry : texts) pointers.push_back(entry.c_str());
  pointers.push_back(nullptr);
}

const keyval_t* _bundle_t::find(const std::string& key) const {
  const auto entry =
      std::find_if(entries.begin(), entries.end(),
                   [&key](const keyval_t& candidate) { return candidate.key == key; });
  return entry == entries.end() ? nullptr : &*entry;
}

bool _bundle_t::remove(const std::string& key) {
  const auto entry =
      std::find_if(entries.begin(), entries.end(),
                   [&key](const keyval_t& candidate) { return candidate.key == key; });
  if (entry == entries.end()) return false;
  entries.erase(entry);
  return true;
}

void _bundle_t::copyFrom(const _bundle_t& other) {
  if (this == &other) return;
  entries.clear();
  for (const auto& entry : other.entries) {
    if (entry.isArray()) {
      entries.emplace_back(entry.key, entry.texts);
    } else {
      entries.emplace_back(entry.key, entry.text);
    }
  }
}

bundle* bundle_create() {
  if (base::strikes(__func__)) return nullptr;
  set_last_result(BUNDLE_ERROR_NONE);
  return new _bundle_t;
}

int bundle_free(bundle* b) {
  if (!b) return BUNDLE_ERROR_INVALID_PARAMETER;
  delete b;
  return BUNDLE_ERROR_NONE;
}

bundle* bundle_dup(bundle* b_from) {
  if (!b_from) {
    set_last_result(BUNDLE_ERROR_INVALID_PARAMETER);
    return nullptr;
  }
  bundle* copy = bundle_create();
  if (!copy) return nullptr;
  copy->copyFrom(*b_from);
  return copy;
}

int bundle_add_str(bundle* b, const char* key, const char* str) {
  if (base::strikes(__func__)) return BUNDLE_ERROR_OUT_OF_MEMORY;
  if (!b || !isText(key) || !str) return BUNDLE_ERROR_INVALID_PARAMETER;
  return b->add(key, std::string(str)) ? BUNDLE_ERROR_NONE : BUNDLE_ERROR_KEY_EXISTS;
}

int bundle_add(bundle* b, const char* key, const char* val) {
  return bundle_add_str(b, key, val);
}

int bundle_add_str_array(bundle* b, const char* key, const char** str_array, const int len) {
  if (!b || !isText(key) || len < 0 || (len > 0 && !str_array)) {
    return BUNDLE_ERROR_INVALID_PARAMETER;
  }
  std::vector<std::string> texts;
  texts.reserve(static_cast<size_t>(len));
  for (int i = 0; i < len; i++) texts.emplace_back(str_array[i] ? str_array[i] : "");
  return b->add(key, std::move(texts)) ? BUNDLE_ERROR_NONE : BUNDLE_ERROR_KEY_EXISTS;
}

int bundle_del(bundle* b, const char* key) {
  if (!b || !isText(key)) return BUNDLE_ERROR_INVALID_PARAMETER;
  return b->remove(key) ? BUNDLE_ERROR_NONE : BUNDLE_ERROR_KEY_NOT_AVAILABLE;
}

int bundle_get_str(bundle* b, const char* key, char** str) {
  if (!str) return BUNDLE_ERROR_INVALID_PARAMETER;
  const keyval_t* entry = findOfType(b, key, BUNDLE_TYPE_STR);
  *str = entry ? const_cast<char*>(entry->text.c_str()) : nullptr;
  return entry ? BUNDLE_ERROR_NONE : get_last_result();
}

const char* bundle_get_val(bundle* b, const char* key) {
  const keyval_t* entry = findOfType(b, key, BUNDLE_TYPE_STR);
  return entry ? entry->text.c_str() : nullptr;
}

const char** bundle_get_str_array(bundle* b, const char* key, int* len) {
  const keyval_t* entry = findOfType(b, key, BUNDLE_TYPE_STR_ARRAY);
  if (len) *len = entry ? static_cast<int>(entry->texts.size()) : 0;
  return entry ? const_cast<const char**>(entry->pointers.data()) : nullptr;
}

int bundle_get_count(bundle* b) {
  set_last_result(b ? BUNDLE_ERROR_NONE : BUNDLE_ERROR_INVALID_PARAMETER);
  return b ? static_cast<int>(b->entries.size()) : 0;
}

int bundle_get_type(bundle* b, const char* key) {
  const bool usable = b && isText(key);
  const keyval_t* entry = usable ? b->find(key) : nullptr;
  set_last_result(entry    ? BUNDLE_ERROR_NONE
                  : usable ? BUNDLE_ERROR_KEY_NOT_AVAILABLE
                           : BUNDLE_ERROR_INVALID_PARAMETER);
  return entry ? entry->type : BUNDLE_TYPE_NONE;
}

void bundle_foreach(bundle* b, bundle_iterator_t iter, void* user_data) {
  set_last_result(b && iter ? BUNDLE_ERROR_NONE : BUNDLE_ERROR_INVALID_PARAMETER);
  if (!b || !iter) return;
  for (const auto& entry : b->entries) iter(entry.key.c_str(), entry.type, &entry, user_data);
}

int bundle_encode(bundle* b, bundle_raw** r, int* len) {
  if (!b || !r || !len) return BUNDLE_ERROR_INVALID_PARAMETER;
  OwnedVariant contents(g_variant_ref_sink(appfw::toVariant(*b)));
  const size_t size = g_variant_get_size(contents.get());
  if (size > INT_MAX - kMagic.size()) return BUNDLE_ERROR_OUT_OF_MEMORY;
  auto* raw = static_cast<bundle_raw*>(malloc(kMagic.size() + size));
  if (!raw) return BUNDLE_ERROR_OUT_OF_MEMORY;
  memcpy(raw, kMagic.data(), kMagic.size());
  g_variant_store(contents.get(), raw + kMagic.size());
  *r = raw;
  *len = static_cast<int>(kMagic.size() + size);
  return BUNDLE_ERROR_NONE;
}

bundle* bundle_decode(const bundle_raw* r, const int len) {
  set_last_result(BUNDLE_ERROR_INVALID_PARAMETER);
  if (!r || len < static_cast<int>(kMagic.size()) || memcmp(r, kMagic.data(), kMagic.size()) != 0) {
    return nullptr;
  }
  common::OwnedBytes bytes(
      g_bytes_new(r + kMagic.size(), static_cast<size_t>(len) - kMagic.size()));
  OwnedVariant contents(
      g_variant_ref_sink(g_variant_new_from_bytes(G_VARIANT_TYPE_VARDICT, bytes.get(), FALSE)));
  if (!g_variant_is_normal_form(contents.get())) return nullptr;
  // Looked through once; of bytes that are not trusted every entry is checked along with all
  // before.
  contents.reset(
      g_variant_ref_sink(g_variant_new_from_bytes(G_VARIANT_TYPE_VARDICT, bytes.get(), TRUE)));
  set_last_result(BUNDLE_ERROR_NONE);
  return appfw::fromVariant(contents.get()).release();
}
