#pragma once

#include <app_control.h>

#include <vector>

#include "ZQVOwned.h"

/// What a launch request says. Everything is optional; an extra of the wrong kind counts as absent.
class ZQVLaunchRequest {
 public:
  using Text = ZQVOwned<char, free>;

  /// `request` is borrowed.
  explicit ZQVLaunchRequest(app_control_h request);

  /// Is this a request for the viewer? If not, the operation is logged.
  static bool isForViewer(app_control_h request);

  bool isSingleShare() const;
  int32_t requestId() const;  ///< 0 when absent
  const char* viewType() const { return _viewType.get(); }
  const char* contentsToken() const { return _contentsToken.get(); }
  /// The files that a messaging application hands over.
  std::vector<Text> files() const;

 private:
  Text _extra(const char* key) const;

  app_control_h _request;
  Text _shareType;
  Text _contentsToken;
  Text _viewType;
  Text _requestId;
};
