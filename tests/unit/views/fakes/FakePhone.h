#pragma once

#include <app_control.h>
#include <net_connection.h>
#include <zelqo.h>

#include <map>
#include <string>
#include <utility>
#include <vector>

/// A launch request as it left the viewer.
struct Launch {
  std::string appId;
  std::string operation;
  std::string uri;
  std::string mime;
  app_control_launch_mode_e mode;
  /// In order of addition; a single text is an array of one.
  std::vector<std::pair<std::string, std::vector<std::string>>> extras;
  app_control_reply_cb reply;

  std::vector<std::string> extra(const std::string& key) const;
  std::vector<std::string> keys() const;
};

/// A request that was forwarded to another application.
struct Forward {
  std::string appId;
  bool hasBundle;
  std::string operation;
  std::vector<std::string> server;
  /// Was the start information in the bundle when it was forwarded?
  bool hasStartInfo;
  bundle* given;
};

struct UsageRecord {
  bool hasHandle;
  std::string uri;
  std::vector<std::pair<std::string, std::string>> entries;
};

struct RecallRequest {
  unsigned int requestId;
  zelqo_recall_cb callback;
  void* userData;
};

/// The platform around the viewer: records what it is asked for and fails where it is told to.
/// Error members are what the call of that name answers, 0 meaning that it works.
struct FakePhone {
  static FakePhone& get();
  void reset();
  /// The "extra" entries of all records of a feature.
  std::vector<std::string> usageOf(const std::string& feature) const;

  int network = CONNECTION_TYPE_WIFI;
  std::vector<std::string> statusMessages;

  int usageCreateError = 0;
  int usageCreateCalls = 0;
  std::vector<UsageRecord> usage;

  struct {
    int open = 0;
    int exists = 0;
    int setImsi = 0;
    int status = 0;
  } accountErrors;
  const char* imsi = "450051234567890";
  const char* serviceStatus = "on";
  std::vector<std::string> accountCalls;

  int recallError = 0;
  std::vector<RecallRequest> recalls;

  struct {
    int create = 0;
    int setAppId = 0;
    int setOperation = 0;
    int setMode = 0;
    int exportBundle = 0;
    int send = 0;
    int forward = 0;
  } launchErrors;
  std::vector<Launch> launches;
  std::vector<Forward> forwards;
  int openRequests = 0;

  std::map<std::string, std::string> preferences;
  std::string caller;
  /// How often the application was asked to end.
  int exits = 0;
  /// Negative: buttons can always be made.
  int buttonsUntilFailure = -1;
};
