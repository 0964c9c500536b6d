/// What a launch request is made of.
#pragma once

#include "Bundle.h"

#include <app_control.h>

#include <string>

struct app_control_s {
  enum class Kind { Request, Received };

  Kind kind = Kind::Request;
  appfw::OwnedBundle data = appfw::emptyBundle();
  /// Where a reply goes: the sender's unique name and its object for this request. Empty when none
  /// is wanted.
  std::string replyTo;
  std::string replyPath;
};

namespace appfw {

using OwnedAppControl = common::Owned<app_control_s, app_control_destroy>;

constexpr const char* kKeyOperation = "__APP_SVC_OP_TYPE__";
constexpr const char* kKeyUri = "__APP_SVC_URI__";
constexpr const char* kKeyMime = "__APP_SVC_MIME_TYPE__";
constexpr const char* kKeyAppId = "__APP_SVC_PKG_NAME__";
constexpr const char* kKeyLaunchMode = "__APP_SVC_LAUNCH_MODE__";

/// One of the platform's own keys, which are no extra data.
bool isSystemKey(const std::string& key);

/// The text under `key`, or an empty one.
std::string textOf(const bundle& data, const char* key);

}  // namespace appfw
