#include <vconf.h>

#include "VconfChanges.h"

#include <base/Fault.h>
#include <base/KeyValueStore.h>
#include <base/PhonePaths.h>
#include <dlog.h>

#include <climits>
#include <cstring>

namespace {

using Store = base::KeyValueStore;

constexpr size_t kMaxTextBytes = 4096;

Store& store() {
  static Store store(base::databaseFolder() + "/vconf.db");
  return store;
}

VconfChanges& changes() {
  static VconfChanges changes;
  return changes;
}

bool isKey(const char* key) {
  return key && *key;
}

template <typename Type>
const Type* get(const char* key, Store::Value& value) {
  if (!isKey(key) || store().get(key, value) != Store::Answer::Done) return nullptr;
  return std::get_if<Type>(&value);
}

/// Listeners hear of a change only when there is one.
int set(const char* key, const Store::Value& value) {
  Store::Value before;
  if (store().get(key, before) == Store::Answer::Done && before == value) return VCONF_OK;
  if (store().set(key, value) != Store::Answer::Done) return VCONF_ERROR;
  VconfChanges::announce(key);
  return VCONF_OK;
}

}  // namespace

char* vconf_get_str(const char* in_key) {
  if (base::strikes(__func__)) return nullptr;
  Store::Value value;
  const auto* text = get<std::string>(in_key, value);
  return text ? strdup(text->c_str()) : nullptr;
}

int vconf_get_int(const char* in_key, int* intval) {
  if (base::strikes(__func__)) return VCONF_ERROR;
  Store::Value value;
  const auto* number = intval ? get<int64_t>(in_key, value) : nullptr;
  if (!number || *number < INT_MIN || *number > INT_MAX) return VCONF_ERROR;
  *intval = static_cast<int>(*number);
  return VCONF_OK;
}

int vconf_get_bool(const char* in_key, int* boolval) {
  if (vconf_get_int(in_key, boolval) != VCONF_OK) return VCONF_ERROR;
  *boolval = *boolval != 0;
  return VCONF_OK;
}

int vconf_set_str(const char* in_key, const char* strval) {
  if (!isKey(in_key) || !strval || strlen(strval) > kMaxTextBytes) return VCONF_ERROR;
  return set(in_key, std::string(strval));
}

int vconf_set_int(const char* in_key, int intval) {
  return isKey(in_key) ? set(in_key, int64_t{intval}) : VCONF_ERROR;
}

int vconf_set_bool(const char* in_key, int boolval) {
  return vconf_set_int(in_key, boolval != 0);
}

int vconf_notify_key_changed(const char* in_key, vconf_callback_fn cb, void* user_data) {
  if (base::strikes(__func__)) return VCONF_ERROR;
  if (!isKey(in_key) || !cb) return VCONF_ERROR;
  changes().add(in_key, cb, user_data);
  return VCONF_OK;
}

int vconf_ignore_key_changed(const char* in_key, vconf_callback_fn cb) {
  if (base::strikes(__func__)) return VCONF_ERROR;
  if (!isKey(in_key) || !cb) return VCONF_ERROR;
  return changes().remove(in_key, cb) ? VCONF_OK : VCONF_ERROR;
}
