/// Launch requests as the phone's own applications send them.
#pragma once

#include <app_control.h>

#include <common/Owned.h>

#include <string>
#include <type_traits>
#include <vector>

namespace companion {

using OwnedRequest = common::Owned<std::remove_pointer_t<app_control_h>, app_control_destroy>;

/// Texts of a request; empty when it has none.
std::string operationOf(app_control_h request);
std::string extraOf(app_control_h request, const char* key);
std::vector<std::string> extrasOf(app_control_h request, const char* key);

/// Tells the sender how its request ended.
void reply(app_control_h request, app_control_result_e result, const std::string& message = {});

/// A request that is answered later, from the user's doing; cancelled when nothing else came.
class PendingReply {
 public:
  PendingReply() = default;
  explicit PendingReply(app_control_h request);
  PendingReply(PendingReply&& other) = default;
  PendingReply& operator=(PendingReply&& other) noexcept;
  ~PendingReply();

  /// The first answer counts.
  void send(app_control_result_e result, const std::string& message = {});

 private:
  OwnedRequest _request;
};

/// The viewer on a share; a message in the status bar when it cannot be started.
void openReceivedShare(const std::string& token, bool single);
void openSentShare(int requestId, bool single);

/// The program of the phone that opens the file.
void openFile(const std::string& path);

/// An application's start page.
void openApplication(const char* appId);

void showMessage(const std::string& message);

}  // namespace companion
