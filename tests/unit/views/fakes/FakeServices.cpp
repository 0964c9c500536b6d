// The services that the viewer only asks or tells something.
#include <app_preference.h>
#include <net_connection.h>
#include <notification_status.h>
#include <orlant_log_manager.h>
#include <ovu.h>
#include <zelqo.h>

#include <cstring>

#include "FakePhone.h"

namespace {

int theUsageManager;
int theAccountHandle;

void recordEntry(const char* key, const int, const bundle_keyval_t*, void* data) {
  auto* pair = static_cast<std::pair<bundle*, UsageRecord*>*>(data);
  pair->second->entries.emplace_back(key, bundle_get_val(pair->first, key));
}

char* copied(const char* text) {
  return text ? strdup(text) : nullptr;
}

int answered(const char* call, int error) {
  FakePhone::get().accountCalls.emplace_back(call);
  return error;
}

}  // namespace

extern "C" {

int connection_create(connection_h* connection) {
  *connection = &FakePhone::get().network;
  return CONNECTION_ERROR_NONE;
}

int connection_get_type(connection_h, connection_type_e* type) {
  *type = static_cast<connection_type_e>(FakePhone::get().network);
  return CONNECTION_ERROR_NONE;
}

int connection_destroy(connection_h) {
  return CONNECTION_ERROR_NONE;
}

int notification_status_message_post(const char* message) {
  FakePhone::get().statusMessages.emplace_back(message);
  return NOTIFICATION_ERROR_NONE;
}

int orlant_log_manager_create(orlant_log_manager_h* handle) {
  ++FakePhone::get().usageCreateCalls;
  if (FakePhone::get().usageCreateError) return FakePhone::get().usageCreateError;
  *handle = reinterpret_cast<orlant_log_manager_h>(&theUsageManager);
  return ORLANT_LOG_ERROR_NONE;
}

int orlant_log_manager_insert(orlant_log_manager_h handle, const char* uri, bundle* data,
                              orlant_log_manager_reply_cb callback, void*, int* requestId) {
  UsageRecord record{handle != nullptr, uri, {}};
  std::pair<bundle*, UsageRecord*> both{data, &record};
  bundle_foreach(data, recordEntry, &both);
  FakePhone::get().usage.push_back(record);
  *requestId = static_cast<int>(FakePhone::get().usage.size());
  if (callback) callback(*requestId, 0, nullptr);
  return handle ? ORLANT_LOG_ERROR_NONE : ORLANT_LOG_ERROR_INVALID_PARAMETER;
}

int orlant_log_manager_destroy(orlant_log_manager_h) {
  return ORLANT_LOG_ERROR_NONE;
}

int ovu_open_handle(ovu_h* handle) {
  const int error = answered("open", FakePhone::get().accountErrors.open);
  if (!error) *handle = reinterpret_cast<ovu_h>(&theAccountHandle);
  return error;
}

int ovu_check_account_exist(ovu_h, char** imsi, char** msisdn) {
  const int error = answered("exists", FakePhone::get().accountErrors.exists);
  if (error) return error;
  *imsi = copied(FakePhone::get().imsi);
  *msisdn = copied(FakePhone::get().imsi ? "+821012345678" : nullptr);
  return error;
}

int ovu_set_imsi(ovu_h, const char* imsi) {
  return answered((std::string("set ") + imsi).c_str(), FakePhone::get().accountErrors.setImsi);
}

int ovu_get_service_status(ovu_h, const char* service, char** status, int cached) {
  const std::string call = std::string("status ") + service + (cached ? " cached" : "");
  const int error = answered(call.c_str(), FakePhone::get().accountErrors.status);
  if (!error) *status = copied(FakePhone::get().serviceStatus);
  return error;
}

int ovu_close_handle(ovu_h) {
  return answered("close", 0);
}

int zelqo_recall_upload(unsigned int requestId, zelqo_recall_cb callback, void* userData) {
  FakePhone::get().recalls.push_back({requestId, callback, userData});
  return FakePhone::get().recallError;
}

int preference_get_string(const char* key, char** value) {
  const auto found = FakePhone::get().preferences.find(key);
  if (found == FakePhone::get().preferences.end()) return PREFERENCE_ERROR_NO_KEY;
  *value = strdup(found->second.c_str());
  return PREFERENCE_ERROR_NONE;
}

int preference_is_existing(const char* key, bool* existing) {
  *existing = FakePhone::get().preferences.count(key) != 0;
  return PREFERENCE_ERROR_NONE;
}

}  // extern "C"
