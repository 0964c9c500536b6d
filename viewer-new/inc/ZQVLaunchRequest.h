#pragma once

#include <app_control.h>

#include <vector>

#include "ZQVOwned.h"

/// What a launch request says. Everything is optional; an extra of the wrong kind counts as absent.
class ZQVLaunchRequest {
 public:
  /// `request` is borrowed.
  explicit ZQVLaunchRequest(app_control_h request);

  /// Is this a request for the viewer? If not, the operation is logged.
  static bool isForViewer(app_control_h request);

  bool isSingleShare() const;
  int32_t requestId() const;  ///< 0 when absent
  const char* viewType() const { return _viewType.get(); }
  const char* contentsToken() const { return _contentsToken.get(); }
  /// The files that a messaging application hands over.
  std::vector<ZQVPlatformText> files() const;

 private:
  ZQVPlatformText _extra(const char* key) const;

  app_control_h _request;
  ZQVPlatformText _shareType;
  ZQVPlatformText _contentsToken;
  ZQVPlatformText _viewType;
  ZQVPlatformText _requestId;
};
