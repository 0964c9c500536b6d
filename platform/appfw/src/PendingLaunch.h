/// A launch under way: delivered, then, when a reply is wanted, watched until it is there.
#pragma once

#include "Bundle.h"

#include <appfw/Launch.h>
#include <common/Owned.h>

#include <string>

namespace appfw {

class PendingLaunch {
 public:
  /// `contents` is a{sv}. The object deletes itself when nothing more is to come.
  static void start(common::OwnedBus bus, std::string name, GVariant* contents,
                    LaunchEvents events);
  ~PendingLaunch();
  PendingLaunch(const PendingLaunch&) = delete;
  PendingLaunch& operator=(const PendingLaunch&) = delete;

 private:
  PendingLaunch(common::OwnedBus bus, std::string name, GVariant* contents, LaunchEvents events);

  static void sentCb(GObject* bus, GAsyncResult* result, void* data);
  static void vanishedCb(GDBusConnection* bus, const char* name, void* data);
  static void replyCb(GDBusConnection* bus, const char* sender, const char* path,
                      const char* interface, const char* method, GVariant* arguments,
                      GDBusMethodInvocation* invocation, void* data);

  void listenForReply();
  void send();
  void sent(GDBusMessage* answer, const GError* error);
  void delivered(const char* callee);
  void replied(const char* sender, GVariant* arguments, GDBusMethodInvocation* invocation);
  void finish(app_control_result_e result, OwnedBundle reply);

  common::OwnedBus _bus;
  const std::string _name;
  common::OwnedVariant _contents;
  LaunchEvents _events;
  std::string _replyPath = "/";
  std::string _callee;  ///< its unique name, once it has the request
  unsigned _object = 0;
  unsigned _watch = 0;
  bool _retried = false;
};

}  // namespace appfw
