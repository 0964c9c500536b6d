#include "AppControl.h"

#include <app_control_internal.h>
#include <aul.h>

#include <base/Fault.h>
#include <cstdlib>
#include <cstring>
#include <vector>

using appfw::isSystemKey;

namespace {

bool isText(const char* text) {
  return text && *text;
}

/// What is wrong with a key of extra data, or 0.
int checkKey(app_control_h app_control, const char* key) {
  if (!app_control || !isText(key)) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  return isSystemKey(key) ? APP_CONTROL_ERROR_KEY_REJECTED : APP_CONTROL_ERROR_NONE;
}

int setText(app_control_h app_control, const char* key, const char* value) {
  if (!app_control) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  app_control->data->remove(key);
  if (value) app_control->data->add(key, std::string(value));
  return APP_CONTROL_ERROR_NONE;
}

int copyText(const char* text, char** copy) {
  *copy = strdup(text);
  return *copy ? APP_CONTROL_ERROR_NONE : APP_CONTROL_ERROR_OUT_OF_MEMORY;
}

int getText(app_control_h app_control, const char* key, char** value) {
  if (!app_control || !value) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  *value = nullptr;
  const char* text = bundle_get_val(app_control->data.get(), key);
  return text ? copyText(text, value) : APP_CONTROL_ERROR_NONE;
}

/// The extra of that key; otherwise `error` says why there is none.
const keyval_t* findExtra(app_control_h app_control, const char* key, bool array, int& error) {
  error = checkKey(app_control, key);
  if (error != APP_CONTROL_ERROR_NONE) return nullptr;
  const keyval_t* entry = app_control->data->find(key);
  if (!entry) {
    error = APP_CONTROL_ERROR_KEY_NOT_FOUND;
  } else if (entry->isArray() != array) {
    error = APP_CONTROL_ERROR_INVALID_DATA_TYPE;
  }
  return error == APP_CONTROL_ERROR_NONE ? entry : nullptr;
}

int createFrom(app_control_s::Kind kind, bundle* data, app_control_h* app_control) {
  if (!data || !app_control) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  *app_control = new app_control_s;
  (*app_control)->kind = kind;
  (*app_control)->data->copyFrom(*data);
  return APP_CONTROL_ERROR_NONE;
}

}  // namespace

bool appfw::isSystemKey(const std::string& key) {
  return key.compare(0, 10, "__APP_SVC_") == 0 || key.compare(0, 6, "__AUL_") == 0;
}

std::string appfw::textOf(const bundle& data, const char* key) {
  const keyval_t* entry = data.find(key);
  return entry ? entry->text : std::string();
}

int app_control_create(app_control_h* app_control) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_OUT_OF_MEMORY;
  if (!app_control) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  *app_control = new app_control_s;
  return APP_CONTROL_ERROR_NONE;
}

int app_control_destroy(app_control_h app_control) {
  if (!app_control) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  delete app_control;
  return APP_CONTROL_ERROR_NONE;
}

int app_control_clone(app_control_h* clone, app_control_h app_control) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_OUT_OF_MEMORY;
  if (!clone || !app_control) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  createFrom(app_control->kind, app_control->data.get(), clone);
  (*clone)->replyTo = app_control->replyTo;
  (*clone)->replyPath = app_control->replyPath;
  return APP_CONTROL_ERROR_NONE;
}

int app_control_set_operation(app_control_h app_control, const char* operation) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_OUT_OF_MEMORY;
  return setText(app_control, appfw::kKeyOperation, operation);
}

int app_control_get_operation(app_control_h app_control, char** operation) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_OUT_OF_MEMORY;
  return getText(app_control, appfw::kKeyOperation, operation);
}

int app_control_set_uri(app_control_h app_control, const char* uri) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_OUT_OF_MEMORY;
  return setText(app_control, appfw::kKeyUri, uri);
}

int app_control_get_uri(app_control_h app_control, char** uri) {
  return getText(app_control, appfw::kKeyUri, uri);
}

int app_control_set_mime(app_control_h app_control, const char* mime) {
  return setText(app_control, appfw::kKeyMime, mime);
}

int app_control_get_mime(app_control_h app_control, char** mime) {
  return getText(app_control, appfw::kKeyMime, mime);
}

int app_control_set_app_id(app_control_h app_control, const char* app_id) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_OUT_OF_MEMORY;
  return setText(app_control, appfw::kKeyAppId, app_id);
}

int app_control_get_app_id(app_control_h app_control, char** app_id) {
  return getText(app_control, appfw::kKeyAppId, app_id);
}

int app_control_set_launch_mode(app_control_h app_control, app_control_launch_mode_e mode) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_OUT_OF_MEMORY;
  switch (mode) {
    case APP_CONTROL_LAUNCH_MODE_SINGLE:
      return setText(app_control, appfw::kKeyLaunchMode, "single");
    case APP_CONTROL_LAUNCH_MODE_GROUP:
      return setText(app_control, appfw::kKeyLaunchMode, "group");
  }
  return APP_CONTROL_ERROR_INVALID_PARAMETER;
}

int app_control_get_launch_mode(app_control_h app_control, app_control_launch_mode_e* mode) {
  if (!app_control || !mode) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  const bool group = appfw::textOf(*app_control->data, appfw::kKeyLaunchMode) == "group";
  *mode = group ? APP_CONTROL_LAUNCH_MODE_GROUP : APP_CONTROL_LAUNCH_MODE_SINGLE;
  return APP_CONTROL_ERROR_NONE;
}

int app_control_add_extra_data(app_control_h app_control, const char* key, const char* value) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_OUT_OF_MEMORY;
  if (!isText(value)) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  const int error = checkKey(app_control, key);
  return error == APP_CONTROL_ERROR_NONE ? setText(app_control, key, value) : error;
}

int app_control_add_extra_data_array(app_control_h app_control, const char* key,
                                     const char* value[], int length) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_OUT_OF_MEMORY;
  const int error = checkKey(app_control, key);
  if (error != APP_CONTROL_ERROR_NONE) return error;
  if (!value || length < 0) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  app_control->data->remove(key);
  return bundle_add_str_array(app_control->data.get(), key, value, length);
}

int app_control_remove_extra_data(app_control_h app_control, const char* key) {
  const int error = checkKey(app_control, key);
  if (error != APP_CONTROL_ERROR_NONE) return error;
  return app_control->data->remove(key) ? APP_CONTROL_ERROR_NONE : APP_CONTROL_ERROR_KEY_NOT_FOUND;
}

int app_control_get_extra_data(app_control_h app_control, const char* key, char** value) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_OUT_OF_MEMORY;
  if (!value) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  *value = nullptr;
  int error = APP_CONTROL_ERROR_NONE;
  const keyval_t* extra = findExtra(app_control, key, false, error);
  return extra ? copyText(extra->text.c_str(), value) : error;
}

int app_control_get_extra_data_array(app_control_h app_control, const char* key, char*** value,
                                     int* length) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_OUT_OF_MEMORY;
  if (!value || !length) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  *value = nullptr;
  *length = 0;
  int error = APP_CONTROL_ERROR_NONE;
  const keyval_t* extra = findExtra(app_control, key, true, error);
  if (!extra) return error;
  const size_t count = extra->texts.size();
  auto** texts = static_cast<char**>(calloc(count + 1, sizeof(char*)));
  if (!texts) return APP_CONTROL_ERROR_OUT_OF_MEMORY;
  for (size_t i = 0; i < count; i++) texts[i] = strdup(extra->texts[i].c_str());
  *value = texts;
  *length = static_cast<int>(count);
  return APP_CONTROL_ERROR_NONE;
}

int app_control_is_extra_data_array(app_control_h app_control, const char* key, bool* array) {
  if (!array) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  const int error = checkKey(app_control, key);
  if (error != APP_CONTROL_ERROR_NONE) return error;
  const keyval_t* entry = app_control->data->find(key);
  if (!entry) return APP_CONTROL_ERROR_KEY_NOT_FOUND;
  *array = entry->isArray();
  return APP_CONTROL_ERROR_NONE;
}

int app_control_foreach_extra_data(app_control_h app_control, app_control_extra_data_cb callback,
                                   void* user_data) {
  if (!app_control || !callback) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  std::vector<std::string> keys;  // the callback may change the request
  for (const auto& entry : app_control->data->entries) {
    if (!isSystemKey(entry.key)) keys.push_back(entry.key);
  }
  for (const auto& key : keys) {
    if (!callback(app_control, key.c_str(), user_data)) break;
  }
  return APP_CONTROL_ERROR_NONE;
}

int app_control_get_caller(app_control_h app_control, char** id) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_OUT_OF_MEMORY;
  if (!id) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  *id = nullptr;
  if (!app_control || app_control->kind != app_control_s::Kind::Received) {
    return APP_CONTROL_ERROR_INVALID_PARAMETER;
  }
  const char* caller = bundle_get_val(app_control->data.get(), AUL_K_CALLER_APPID);
  return caller ? copyText(caller, id) : APP_CONTROL_ERROR_KEY_NOT_FOUND;
}

int app_control_is_reply_requested(app_control_h app_control, bool* requested) {
  if (!app_control || !requested || app_control->kind != app_control_s::Kind::Received) {
    return APP_CONTROL_ERROR_INVALID_PARAMETER;
  }
  *requested = app_control->data->find(AUL_K_WAIT_RESULT) != nullptr;
  return APP_CONTROL_ERROR_NONE;
}

int app_control_import_from_bundle(app_control_h app_control, bundle* data) {
  if (!app_control || !data) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  app_control->data->copyFrom(*data);
  return APP_CONTROL_ERROR_NONE;
}

int app_control_export_as_bundle(app_control_h app_control, bundle** data) {
  if (base::strikes(__func__)) return APP_CONTROL_ERROR_OUT_OF_MEMORY;
  if (!app_control || !data) return APP_CONTROL_ERROR_INVALID_PARAMETER;
  *data = bundle_dup(app_control->data.get());
  return *data ? APP_CONTROL_ERROR_NONE : APP_CONTROL_ERROR_OUT_OF_MEMORY;
}

int app_control_create_request(bundle* data, app_control_h* app_control) {
  return createFrom(app_control_s::Kind::Request, data, app_control);
}

int app_control_create_event(bundle* data, app_control_h* app_control) {
  return createFrom(app_control_s::Kind::Received, data, app_control);
}
