#include <base/Fault.h>
#include <base/PhonePaths.h>
#include <glib.h>
#include <orlant_log_manager.h>

#include <memory>

#include <common/Database.h>

namespace {

constexpr const char* kSchema =
    "CREATE TABLE IF NOT EXISTS record(id INTEGER PRIMARY KEY AUTOINCREMENT, "
    "time INTEGER NOT NULL, uri TEXT NOT NULL, app_id TEXT, feature TEXT, extra TEXT)";

struct Reply {
  std::weak_ptr<bool> handle;
  orlant_log_manager_reply_cb callback;
  void* userData;
  int requestId;
  int error;
};

gboolean deliver(gpointer data) {
  const auto* reply = static_cast<Reply*>(data);
  if (!reply->handle.expired()) reply->callback(reply->requestId, reply->error, reply->userData);
  return G_SOURCE_REMOVE;
}

void deleteReply(gpointer data) {
  delete static_cast<Reply*>(data);
}

std::optional<std::string> field(bundle* data, const char* key) {
  char* value = nullptr;
  if (bundle_get_str(data, key, &value) != 0 || !value) return std::nullopt;
  return value;
}

bool insert(common::Database& database, const char* uri, bundle* data) {
  auto statement = database.prepare(
      "INSERT INTO record(time, uri, app_id, feature, extra) VALUES(?, ?, ?, ?, ?)");
  statement.bind(g_get_real_time() / G_TIME_SPAN_MILLISECOND).bind(std::string(uri));
  for (const char* key : {"app_id", "feature", "extra"}) statement.bind(field(data, key));
  return statement.run();
}

}  // namespace

struct orlant_log_manager_s {
  std::unique_ptr<common::Database> database;
  int lastRequest = 0;
  std::shared_ptr<bool> alive = std::make_shared<bool>(true);
};

int orlant_log_manager_create(orlant_log_manager_h* handle) {
  if (base::strikes(__func__)) return ORLANT_LOG_ERROR_STORE;
  if (!handle) return ORLANT_LOG_ERROR_INVALID_PARAMETER;
  *handle = nullptr;
  auto database = common::Database::open(base::databaseFolder() + "/usagelog.db", kSchema);
  if (!database) return ORLANT_LOG_ERROR_STORE;
  *handle = new orlant_log_manager_s{std::move(database)};
  return ORLANT_LOG_ERROR_NONE;
}

int orlant_log_manager_insert(orlant_log_manager_h handle, const char* content_uri, bundle* data,
                              orlant_log_manager_reply_cb callback, void* user_data,
                              int* request_id) {
  if (base::strikes(__func__)) return ORLANT_LOG_ERROR_STORE;
  if (!handle || !content_uri || !data) return ORLANT_LOG_ERROR_INVALID_PARAMETER;
  const int request = ++handle->lastRequest;
  if (request_id) *request_id = request;
  const int error =
      insert(*handle->database, content_uri, data) ? ORLANT_LOG_ERROR_NONE : ORLANT_LOG_ERROR_STORE;
  if (callback) {
    g_idle_add_full(G_PRIORITY_DEFAULT, deliver,
                    new Reply{handle->alive, callback, user_data, request, error}, deleteReply);
  }
  return ORLANT_LOG_ERROR_NONE;
}

int orlant_log_manager_destroy(orlant_log_manager_h handle) {
  if (!handle) return ORLANT_LOG_ERROR_INVALID_PARAMETER;
  delete handle;
  return ORLANT_LOG_ERROR_NONE;
}
