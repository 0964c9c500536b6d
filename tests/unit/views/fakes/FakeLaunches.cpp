// The launching half of the application framework: requests are real, but they only get as far as
// FakePhone.
#include <app_control_internal.h>
#include <aul.h>
#include <dlfcn.h>

#include <cstdlib>
#include <cstring>

#include "FakePhone.h"

namespace {

template <typename Function>
Function* real(const char* name, Function*) {
  return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

#define REAL(function) real(#function, function)

std::string taken(char* text) {
  std::string copy = text ? text : "";
  free(text);
  return copy;
}

bool recordExtra(app_control_h request, const char* key, void* data) {
  auto* launch = static_cast<Launch*>(data);
  std::vector<std::string> values;
  bool isArray = false;
  app_control_is_extra_data_array(request, key, &isArray);
  if (isArray) {
    char** texts = nullptr;
    int count = 0;
    app_control_get_extra_data_array(request, key, &texts, &count);
    for (int i = 0; i < count; ++i) values.push_back(taken(texts[i]));
    free(texts);
  } else {
    char* text = nullptr;
    app_control_get_extra_data(request, key, &text);
    values.push_back(taken(text));
  }
  launch->extras.emplace_back(key, values);
  return true;
}

Launch recordOf(app_control_h request) {
  Launch launch{};
  char* text = nullptr;
  app_control_get_app_id(request, &text);
  launch.appId = taken(text);
  text = nullptr;
  app_control_get_operation(request, &text);
  launch.operation = taken(text);
  text = nullptr;
  app_control_get_uri(request, &text);
  launch.uri = taken(text);
  text = nullptr;
  app_control_get_mime(request, &text);
  launch.mime = taken(text);
  app_control_get_launch_mode(request, &launch.mode);
  app_control_foreach_extra_data(request, recordExtra, &launch);
  return launch;
}

}  // namespace

extern "C" {

int app_control_create(app_control_h* request) {
  if (FakePhone::get().launchErrors.create) return FakePhone::get().launchErrors.create;
  ++FakePhone::get().openRequests;
  return REAL(app_control_create)(request);
}

int app_control_clone(app_control_h* clone, app_control_h request) {
  const int error = REAL(app_control_clone)(clone, request);
  if (!error) ++FakePhone::get().openRequests;
  return error;
}

int app_control_destroy(app_control_h request) {
  --FakePhone::get().openRequests;
  return REAL(app_control_destroy)(request);
}

int app_control_set_app_id(app_control_h request, const char* id) {
  if (FakePhone::get().launchErrors.setAppId) return FakePhone::get().launchErrors.setAppId;
  return REAL(app_control_set_app_id)(request, id);
}

int app_control_set_operation(app_control_h request, const char* operation) {
  if (FakePhone::get().launchErrors.setOperation) return FakePhone::get().launchErrors.setOperation;
  return REAL(app_control_set_operation)(request, operation);
}

int app_control_set_launch_mode(app_control_h request, app_control_launch_mode_e mode) {
  if (FakePhone::get().launchErrors.setMode) return FakePhone::get().launchErrors.setMode;
  return REAL(app_control_set_launch_mode)(request, mode);
}

int app_control_export_as_bundle(app_control_h request, bundle** data) {
  if (FakePhone::get().launchErrors.exportBundle) return FakePhone::get().launchErrors.exportBundle;
  return REAL(app_control_export_as_bundle)(request, data);
}

int app_control_send_launch_request(app_control_h request, app_control_reply_cb callback, void*) {
  Launch launch = recordOf(request);
  launch.reply = callback;
  FakePhone::get().launches.push_back(launch);
  return FakePhone::get().launchErrors.send;
}

int app_control_get_caller(app_control_h, char** id) {
  if (FakePhone::get().caller.empty()) return APP_CONTROL_ERROR_KEY_NOT_FOUND;
  *id = strdup(FakePhone::get().caller.c_str());
  return APP_CONTROL_ERROR_NONE;
}

int aul_forward_app(const char* appId, bundle* data) {
  Forward forward{appId, data != nullptr, "", {}, false, data};
  if (data) {
    const char* operation = bundle_get_val(data, "__APP_SVC_OP_TYPE__");
    forward.operation = operation ? operation : "";
    int count = 0;
    const char** server = bundle_get_str_array(data, "server", &count);
    for (int i = 0; i < count; ++i) forward.server.emplace_back(server[i]);
    forward.hasStartInfo = bundle_get_type(data, "__APP_SVC_START_INFO__") != BUNDLE_TYPE_NONE;
  }
  FakePhone::get().forwards.push_back(forward);
  return data ? FakePhone::get().launchErrors.forward : AUL_R_EINVAL;
}

}  // extern "C"
