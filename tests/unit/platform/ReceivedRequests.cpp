#include "ReceivedRequests.h"

ReceivedRequests::ReceivedRequests() {
  EXPECT_TRUE(_service.start([this] { _nameLost = true; }));
}

void ReceivedRequests::start() {
  _service.deliverTo([this](app_control_h request) {
    app_control_h kept = nullptr;
    app_control_clone(&kept, request);
    _requests.emplace_back(kept);
  });
}

bool ReceivedRequests::waitFor(size_t count) {
  return waitUntil([&] { return _requests.size() >= count; });
}

std::string ReceivedRequests::extra(app_control_h request, const char* key) {
  char* value = nullptr;
  app_control_get_extra_data(request, key, &value);
  return take(value);
}

std::vector<std::string> ReceivedRequests::extraKeys(app_control_h request) {
  std::vector<std::string> keys;
  app_control_foreach_extra_data(
      request,
      [](app_control_h, const char* key, void* data) {
        static_cast<std::vector<std::string>*>(data)->push_back(key);
        return true;
      },
      &keys);
  return keys;
}

std::string ReceivedRequests::caller(app_control_h request) {
  char* id = nullptr;
  const int error = app_control_get_caller(request, &id);
  return error == APP_CONTROL_ERROR_NONE ? take(id) : "error " + std::to_string(error);
}
