#include "ZQVLaunchRequest.h"

#include <cstdlib>
#include <cstring>

#include "ZQVLog.h"

namespace {

constexpr const char* kLaunchViewer = "http://tizen.org/appcontrol/operation/launch_viewer";

}  // namespace

ZQVLaunchRequest::ZQVLaunchRequest(app_control_h request)
    : _request(request),
      _shareType(_extra("share_type")),
      _contentsToken(_extra("contents_token")),
      _viewType(_extra("view_type")),
      _requestId(_extra("request_id")) {}

bool ZQVLaunchRequest::isForViewer(app_control_h request) {
  ZQVPlatformText operation;
  if (app_control_get_operation(request, operation.out()) != APP_CONTROL_ERROR_NONE || !operation) {
    ZQV_ERROR("Invalid operation: %s", "operation is NULL");
    return false;
  }
  if (strcmp(operation.get(), kLaunchViewer) != 0) {
    ZQV_ERROR("Invalid operation: %s", operation.get());
    return false;
  }
  return true;
}

bool ZQVLaunchRequest::isSingleShare() const {
  return g_strcmp0(_shareType.get(), "single_share") == 0;
}

int32_t ZQVLaunchRequest::requestId() const {
  return _requestId ? static_cast<int32_t>(strtol(_requestId.get(), nullptr, 10)) : 0;
}

std::vector<ZQVPlatformText> ZQVLaunchRequest::files() const {
  std::vector<ZQVPlatformText> files;
  ZQVOwned<char*, free> paths;
  int length = 0;
  if (app_control_get_extra_data_array(_request, "freemsg_send_data", paths.out(), &length) !=
      APP_CONTROL_ERROR_NONE) {
    return files;
  }
  for (int i = 0; paths && i < length; ++i) files.emplace_back(paths.get()[i]);
  return files;
}

ZQVPlatformText ZQVLaunchRequest::_extra(const char* key) const {
  ZQVPlatformText value;
  if (app_control_get_extra_data(_request, key, value.out()) != APP_CONTROL_ERROR_NONE) {
    value.reset();
  }
  return value;
}
