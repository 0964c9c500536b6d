/// Applications on the session bus: "phoneapp.i" and the application id, in which bytes that a bus
/// name may not hold (and '_', and a digit or a dot after a dot) stand as "_xx".
#pragma once

#include <common/Owned.h>

#include <string>

namespace appfw {

constexpr const char* kAppPath = "/phone/App";
constexpr const char* kAppInterface = "phone.App1";
constexpr const char* kReplyInterface = "phone.AppReply1";

/// Empty when there can be no such name.
std::string busName(const std::string& appId);
/// Empty when it is no application's name.
std::string appIdOfBusName(const std::string& name);

/// Whether the application runs or can be started. Asks the bus only, so it never waits for the
/// application; while the bus does not answer, it may well be.
bool isInstalled(GDBusConnection* bus, const std::string& appId);

/// Who sent a message, as the bus knows it.
struct Caller {
  std::string appId;  ///< empty when it is no application
  int pid = 0;        ///< 0 when it has gone
};
Caller findCaller(GDBusConnection* bus, const char* sender);

/// Asks for an application's name for this process. Flags are the bus's own; true when it is owned,
/// or at least queued for where the flags allow that.
bool requestName(GDBusConnection* bus, const std::string& name, unsigned flags);
void releaseName(GDBusConnection* bus, const std::string& name);

}  // namespace appfw
