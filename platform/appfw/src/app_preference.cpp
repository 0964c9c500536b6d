#include <app_preference.h>
#include <appfw/AppId.h>
#include <appfw/PreferenceStore.h>

#include <base/Fault.h>
#include <cstring>

namespace {

appfw::PreferenceStore& ownStore() {
  static appfw::PreferenceStore store(appfw::applicationId());
  return store;
}

}  // namespace

int preference_set_string(const char* key, const char* value) {
  if (base::strikes(__func__)) return PREFERENCE_ERROR_IO_ERROR;
  if (!key || !value) return PREFERENCE_ERROR_INVALID_PARAMETER;
  return ownStore().setText(key, value);
}

int preference_get_string(const char* key, char** value) {
  if (base::strikes(__func__)) return PREFERENCE_ERROR_IO_ERROR;
  if (!value) return PREFERENCE_ERROR_INVALID_PARAMETER;
  *value = nullptr;
  if (!key) return PREFERENCE_ERROR_INVALID_PARAMETER;
  std::string text;
  const int error = ownStore().getText(key, text);
  if (error != PREFERENCE_ERROR_NONE) return error;
  *value = strdup(text.c_str());
  return *value ? PREFERENCE_ERROR_NONE : PREFERENCE_ERROR_OUT_OF_MEMORY;
}

int preference_is_existing(const char* key, bool* existing) {
  if (base::strikes(__func__)) return PREFERENCE_ERROR_IO_ERROR;
  if (!key || !existing) return PREFERENCE_ERROR_INVALID_PARAMETER;
  std::string text;
  const int error = ownStore().getText(key, text);
  *existing = error == PREFERENCE_ERROR_NONE;
  return error == PREFERENCE_ERROR_NO_KEY ? PREFERENCE_ERROR_NONE : error;
}

int preference_remove(const char* key) {
  if (base::strikes(__func__)) return PREFERENCE_ERROR_IO_ERROR;
  return key ? ownStore().remove(key) : PREFERENCE_ERROR_INVALID_PARAMETER;
}

int preference_remove_all() {
  return ownStore().removeAll();
}

int preference_foreach_item(preference_item_cb callback, void* user_data) {
  if (!callback) return PREFERENCE_ERROR_INVALID_PARAMETER;
  std::vector<std::string> keys;
  const int error = ownStore().keys(keys);
  for (const auto& key : keys) {
    if (!callback(key.c_str(), user_data)) break;
  }
  return error;
}
