#include "FakePlatform.h"

#include <Ecore_File.h>
#include <Elementary.h>
#include <app_common.h>
#include <app_control.h>
#include <app_preference.h>
#include <contacts.h>
#include <dlfcn.h>
#include <efl_assist.h>
#include <media_content.h>
#include <mime_type.h>
#include <net_connection.h>
#include <notification_status.h>
#include <orlant_log_manager.h>
#include <sys/stat.h>
#include <system_settings.h>
#include <vconf.h>

#include <cerrno>
#include <cstring>
#include <ctime>
#include <list>
#include <utility>

#include "ZQVSharedFiles.h"

FakePlatform& FakePlatform::get() {
  static FakePlatform platform;
  return platform;
}

void FakePlatform::reset() {
  // What the service hands out stays valid until the process ends.
  static std::list<std::map<std::string, FakeShare>> receivedBefore;
  static std::list<std::map<int, FakeShare>> sentBefore;
  receivedBefore.push_back(std::move(received));
  sentBefore.push_back(std::move(sent));
  *this = FakePlatform();
}

namespace {

FakePlatform& platform() {
  return FakePlatform::get();
}

FakeShare* shareOf(zelqo_share_h handle) {
  return reinterpret_cast<FakeShare*>(handle);
}
zelqo_share_h handleOf(FakeShare* share) {
  return reinterpret_cast<zelqo_share_h>(share);
}

int give(const Text& from, char** text) {
  *text = from ? strdup(from->c_str()) : nullptr;
  return from ? ZELQO_ERROR_NONE : ZELQO_ERROR_NO_DATA;
}

struct FakeContactList {
  std::vector<FakeContact> records;
  size_t at = 0;
};

struct FakeQuery {
  std::string number;
};

struct FakeFilter {
  std::string condition;
};

template <typename Function>
Function* real(const char* name, Function*) {
  return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

}  // namespace

extern "C" {

// The sharing service

int zelqo_push_info_get_handle(const char* token, zelqo_share_h* handle) {
  const auto found = platform().received.find(token);
  if (found == platform().received.end()) return ZELQO_ERROR_NO_DATA;
  *handle = handleOf(&found->second);
  return ZELQO_ERROR_NONE;
}

int zelqo_push_info_get_sender_msisdn(zelqo_share_h handle, char** msisdn) {
  const Text& sender = shareOf(handle)->sender;
  if (!sender) return ZELQO_ERROR_NO_DATA;
  *msisdn = const_cast<char*>(sender->c_str());
  return ZELQO_ERROR_NONE;
}

int zelqo_push_info_get_content_info_count(zelqo_share_h handle, unsigned int* count) {
  *count = static_cast<unsigned int>(shareOf(handle)->files.size());
  return shareOf(handle)->countError;
}

int zelqo_push_info_get_expired_time(zelqo_share_h handle, unsigned long long* time) {
  *time = shareOf(handle)->expiry;
  return shareOf(handle)->expiryError;
}

int zelqo_content_info_get_file_size(zelqo_share_h handle, unsigned int index, unsigned int* size) {
  *size = shareOf(handle)->files.at(index).size;
  return ZELQO_ERROR_NONE;
}

int zelqo_content_info_get_file_name(zelqo_share_h handle, unsigned int index, char** name) {
  return give(shareOf(handle)->files.at(index).name, name);
}

int zelqo_content_info_get_content_type(zelqo_share_h handle, unsigned int index, char** type) {
  return give(shareOf(handle)->files.at(index).type, type);
}

int zelqo_content_info_get_thumbnail_url(zelqo_share_h handle, unsigned int index, char** url) {
  return give(shareOf(handle)->files.at(index).thumb, url);
}

int zelqo_content_info_get_mid_thumbnail_url(zelqo_share_h handle, unsigned int index, char** url) {
  return give(shareOf(handle)->files.at(index).mid, url);
}

int zelqo_content_info_get_big_thumbnail_url(zelqo_share_h handle, unsigned int index, char** url) {
  return give(shareOf(handle)->files.at(index).big, url);
}

int zelqo_content_info_get_download_url(zelqo_share_h handle, unsigned int index, char** url) {
  platform().askedUrls.push_back(index);
  return give(shareOf(handle)->files.at(index).url, url);
}

int zelqo_upload_info_get_handle(int requestId, zelqo_share_h* handle) {
  const auto found = platform().sent.find(requestId);
  if (found == platform().sent.end()) return ZELQO_ERROR_NO_DATA;
  *handle = handleOf(&found->second);
  return ZELQO_ERROR_NONE;
}

int zelqo_upload_info_get_recipient_msisdn_list(zelqo_share_h handle, zelqo_recipient_s*** list,
                                                unsigned int* count) {
  static std::vector<zelqo_recipient_s> records;
  static std::vector<zelqo_recipient_s*> pointers;
  FakeShare* share = shareOf(handle);
  if (share->recipientsError) return share->recipientsError;
  records.clear();
  pointers.clear();
  for (std::string& number : share->recipients) records.push_back({0, number.data()});
  for (auto& record : records) pointers.push_back(&record);
  *list = pointers.data();
  *count = static_cast<unsigned int>(pointers.size());
  return ZELQO_ERROR_NONE;
}

int zelqo_upload_info_get_content_info_count(zelqo_share_h handle, unsigned int* count) {
  *count = static_cast<unsigned int>(shareOf(handle)->files.size());
  return shareOf(handle)->countError;
}

int zelqo_upload_info_get_content_file_path(zelqo_share_h handle, unsigned int index, char** path) {
  return give(shareOf(handle)->files.at(index).path, path);
}

int zelqo_request_download(const char** urls, unsigned int count, const char* folder, int priority,
                           int flags, zelqo_download_cb callback, void* userData) {
  platform().downloads.push_back(
      {{urls, urls + count}, folder, priority, flags, callback, userData});
  return platform().downloadError;
}

// Preferences

int preference_get_string(const char* key, char** value) {
  const auto found = platform().preferences.find(key);
  if (found == platform().preferences.end()) return PREFERENCE_ERROR_NO_KEY;
  *value = strdup(found->second.c_str());
  return PREFERENCE_ERROR_NONE;
}

int preference_set_string(const char* key, const char* value) {
  platform().preferences[key] = value;
  return PREFERENCE_ERROR_NONE;
}

int preference_is_existing(const char* key, bool* existing) {
  *existing = platform().preferences.count(key) > 0;
  return PREFERENCE_ERROR_NONE;
}

int preference_remove(const char* key) {
  return platform().preferences.erase(key) ? PREFERENCE_ERROR_NONE : PREFERENCE_ERROR_NO_KEY;
}

// Contacts

int contacts_connect(void) {
  return platform().contactsConnectError;
}
int contacts_disconnect(void) {
  return platform().contactsConnectError;
}
int contacts_db_add_changed_cb(const char*, contacts_db_changed_cb callback, void* data) {
  platform().contactsChanged = callback;
  platform().contactsChangedData = data;
  return platform().contactsConnectError;
}
int contacts_db_remove_changed_cb(const char*, contacts_db_changed_cb, void*) {
  return platform().contactsConnectError;
}

int contacts_filter_create(const char*, contacts_filter_h* filter) {
  ++platform().openContactHandles;
  *filter = reinterpret_cast<contacts_filter_h>(new FakeQuery);
  return CONTACTS_ERROR_NONE;
}

int contacts_filter_destroy(contacts_filter_h filter) {
  --platform().openContactHandles;
  delete reinterpret_cast<FakeQuery*>(filter);
  return CONTACTS_ERROR_NONE;
}

int contacts_filter_add_str(contacts_filter_h filter, unsigned int property,
                            contacts_match_str_flag_e match, const char* value) {
  if (property == _contacts_person_number.number && match == CONTACTS_MATCH_CONTAINS) {
    reinterpret_cast<FakeQuery*>(filter)->number = value;
  }
  return CONTACTS_ERROR_NONE;
}

int contacts_query_create(const char*, contacts_query_h* query) {
  ++platform().openContactHandles;
  *query = reinterpret_cast<contacts_query_h>(new FakeQuery);
  return CONTACTS_ERROR_NONE;
}

int contacts_query_destroy(contacts_query_h query) {
  --platform().openContactHandles;
  delete reinterpret_cast<FakeQuery*>(query);
  return CONTACTS_ERROR_NONE;
}

int contacts_query_set_filter(contacts_query_h query, contacts_filter_h filter) {
  *reinterpret_cast<FakeQuery*>(query) = *reinterpret_cast<FakeQuery*>(filter);
  return CONTACTS_ERROR_NONE;
}

int contacts_db_get_records_with_query(contacts_query_h query, int, int, contacts_list_h* list) {
  const std::string& number = reinterpret_cast<FakeQuery*>(query)->number;
  platform().contactQueries.push_back(number);
  if (platform().contactsError) return platform().contactsError;
  auto* found = new FakeContactList;
  for (const FakeContact& contact : platform().contacts) {
    if (contact.number.find(number) != std::string::npos) found->records.push_back(contact);
  }
  ++platform().openContactHandles;
  *list = reinterpret_cast<contacts_list_h>(found);
  return CONTACTS_ERROR_NONE;
}

int contacts_list_get_current_record_p(contacts_list_h list, contacts_record_h* record) {
  auto* found = reinterpret_cast<FakeContactList*>(list);
  if (found->at >= found->records.size()) return CONTACTS_ERROR_NO_DATA;
  *record = reinterpret_cast<contacts_record_h>(&found->records[found->at]);
  return CONTACTS_ERROR_NONE;
}

int contacts_list_next(contacts_list_h list) {
  auto* found = reinterpret_cast<FakeContactList*>(list);
  if (found->at + 1 >= found->records.size()) return CONTACTS_ERROR_NO_DATA;
  ++found->at;
  return CONTACTS_ERROR_NONE;
}

int contacts_list_destroy(contacts_list_h list, bool) {
  --platform().openContactHandles;
  delete reinterpret_cast<FakeContactList*>(list);
  return CONTACTS_ERROR_NONE;
}

int contacts_record_get_str_p(contacts_record_h record, unsigned int property, char** value) {
  auto* contact = reinterpret_cast<FakeContact*>(record);
  Text& text = property == _contacts_person_number.display_name ? contact->name : contact->image;
  *value = text ? text->data() : nullptr;
  return CONTACTS_ERROR_NONE;
}

// Media database and MIME types

int media_content_connect(void) {
  if (platform().mediaConnectError) return platform().mediaConnectError;
  ++platform().mediaConnections;
  return MEDIA_CONTENT_ERROR_NONE;
}

int media_content_disconnect(void) {
  --platform().mediaConnections;
  return platform().mediaDisconnectError;
}

int media_filter_create(filter_h* filter) {
  if (platform().mediaFilterError) return platform().mediaFilterError;
  ++platform().openMediaHandles;
  *filter = reinterpret_cast<filter_h>(new FakeFilter);
  return MEDIA_CONTENT_ERROR_NONE;
}

int media_filter_destroy(filter_h filter) {
  --platform().openMediaHandles;
  delete reinterpret_cast<FakeFilter*>(filter);
  return MEDIA_CONTENT_ERROR_NONE;
}

int media_filter_set_condition(filter_h filter, const char* condition,
                               media_content_collation_e collation) {
  platform().mediaConditions.push_back(condition + std::string("|") + std::to_string(collation));
  reinterpret_cast<FakeFilter*>(filter)->condition = condition;
  return platform().mediaConditionError;
}

int media_info_foreach_media_from_db(filter_h filter, media_info_cb callback, void* data) {
  if (platform().mediaForeachError) return platform().mediaForeachError;
  for (auto& [path, thumbnail] : platform().media) {
    if (reinterpret_cast<FakeFilter*>(filter)->condition == "MEDIA_PATH = '" + path + "'") {
      callback(reinterpret_cast<media_info_h>(&thumbnail), data);
      callback(reinterpret_cast<media_info_h>(&thumbnail), data);
    }
  }
  return MEDIA_CONTENT_ERROR_NONE;
}

int media_info_clone(media_info_h* clone, media_info_h media) {
  ++platform().openMediaHandles;
  *clone = reinterpret_cast<media_info_h>(new Text(*reinterpret_cast<Text*>(media)));
  return MEDIA_CONTENT_ERROR_NONE;
}

int media_info_destroy(media_info_h media) {
  --platform().openMediaHandles;
  delete reinterpret_cast<Text*>(media);
  return MEDIA_CONTENT_ERROR_NONE;
}

int media_info_get_thumbnail_path(media_info_h media, char** path) {
  const Text& thumbnail = *reinterpret_cast<Text*>(media);
  *path = thumbnail ? strdup(thumbnail->c_str()) : nullptr;
  return platform().mediaThumbnailError;
}

int mime_type_get_mime_type(const char* extension, char** type) {
  const auto found = platform().mimeTypes.find(extension);
  *type = strdup(found == platform().mimeTypes.end() ? "application/octet-stream"
                                                     : found->second.c_str());
  return MIME_TYPE_ERROR_NONE;
}

// Network, messages, settings, launching, theme

int connection_create(connection_h* connection) {
  if (platform().connectionCreateError) return platform().connectionCreateError;
  *connection = &platform().network;
  return CONNECTION_ERROR_NONE;
}

int connection_get_type(connection_h, connection_type_e* type) {
  if (platform().connectionTypeError) return platform().connectionTypeError;
  *type = static_cast<connection_type_e>(platform().network);
  return CONNECTION_ERROR_NONE;
}

int connection_destroy(connection_h) {
  ++platform().connectionsDestroyed;
  return CONNECTION_ERROR_NONE;
}

int notification_status_message_post(const char* message) {
  platform().messages.emplace_back(message);
  return 0;
}

char* vconf_get_str(const char* key) {
  if (strcmp(key, "db/menu_widget/language") == 0) return strdup("en_US.UTF-8");
  const bool region = strcmp(key, "db/menu_widget/regionformat") == 0 && platform().regionFormat;
  return region ? strdup(platform().regionFormat->c_str()) : nullptr;
}

char* app_get_resource_path(void) {
  return strdup(VIEWER_RESOURCES "/");
}

int app_control_add_extra_data(app_control_h request, const char* key, const char* value) {
  if (platform().failingExtra == key) return APP_CONTROL_ERROR_KEY_REJECTED;
  return real("app_control_add_extra_data", app_control_add_extra_data)(request, key, value);
}

Eina_Bool ea_theme_font_get(const char* code, char** font, int* size) {
  if (strcmp(code, "unknown") == 0) return EINA_FALSE;
  *font = strdup("Sans");
  *size = strcmp(code, "T024") == 0 ? 24 : 34;
  return EINA_TRUE;
}

Eina_Bool ea_theme_color_get(const char* code, int* r, int* g, int* b, int* a, int*, int*, int*,
                             int*, int*, int*, int*, int*) {
  if (strcmp(code, "unknown") == 0) return EINA_FALSE;
  *r = strcmp(code, "T024") == 0 ? 0x12 : 0;
  *g = 0x34;
  *b = 0x56;
  *a = 0x80;
  return EINA_TRUE;
}

Eina_Bool ea_theme_object_color_set(Evas_Object* object, const char* code) {
  evas_object_data_set(object, "test_color", strdup(code));
  return EINA_TRUE;  // NOLINT(clang-analyzer-unix.Malloc): the object has it
}

char* app_get_shared_resource_path(void) {
  return strdup(VIEWER_RESOURCES "/");
}

int system_settings_set_changed_cb(system_settings_key_e key, system_settings_changed_cb callback,
                                   void* data) {
  platform().watchedSettings.push_back(key);
  platform().settingCallbacks[key] = {reinterpret_cast<void (*)(int, void*)>(callback), data};
  return 0;
}

int system_settings_unset_changed_cb(system_settings_key_e) {
  return 0;
}

int orlant_log_manager_create(orlant_log_manager_h* handle) {
  *handle = reinterpret_cast<orlant_log_manager_h>(&platform());
  return 0;
}

int orlant_log_manager_insert(orlant_log_manager_h, const char*, bundle*,
                              orlant_log_manager_reply_cb, void*, int*) {
  ++platform().usageRecords;
  return 0;
}

int orlant_log_manager_destroy(orlant_log_manager_h) {
  return 0;
}

time_t time(time_t* now) noexcept {
  const time_t answer = platform().now ? static_cast<time_t>(platform().now)
                                       : static_cast<time_t>(real("time", time)(nullptr));
  if (now) *now = answer;
  return answer;
}

void elm_exit(void) {
  ++platform().exits;
}

void elm_win_lower(Evas_Object* window) {
  ++platform().lowered;
  real("elm_win_lower", elm_win_lower)(window);
}

// Files of the phone

static bool isPhoneFile(const char* path) {
  return strncmp(path, "/opt/usr/", 9) == 0;
}

Eina_Bool ecore_file_exists(const char* path) {
  if (!path || !isPhoneFile(path)) return real("ecore_file_exists", ecore_file_exists)(path);
  return platform().files.count(path) > 0;
}

long long ecore_file_size(const char* path) {
  if (!isPhoneFile(path)) return real("ecore_file_size", ecore_file_size)(path);
  const auto found = platform().files.find(path);
  return found == platform().files.end() ? 0 : found->second;
}

Eina_Bool ecore_file_mkdir(const char* path) {
  if (!isPhoneFile(path)) return real("ecore_file_mkdir", ecore_file_mkdir)(path);
  errno = EACCES;
  if (!platform().foldersCanBeMade) return EINA_FALSE;
  platform().madeFolders.push_back(path);
  platform().files[path] = 4096;
  return EINA_TRUE;
}

Eina_Bool ecore_file_can_write(const char* path) {
  if (!isPhoneFile(path)) return real("ecore_file_can_write", ecore_file_can_write)(path);
  return platform().foldersAreWritable;
}

int chmod(const char* path, mode_t mode) {
  if (!isPhoneFile(path)) return real("chmod", chmod)(path, mode);
  platform().changedModes.push_back(path + std::string(" ") + std::to_string(mode));
  errno = platform().chmodError;
  return platform().chmodError ? -1 : 0;
}

/// The phone's pictures lie in the build's image of it; the viewer is told of the phone's path.
Eina_Bool elm_image_file_set(Evas_Object* image, const char* file, const char* group) {
  evas_object_data_set(image, "test_file", file ? eina_stringshare_add(file) : nullptr);
  const std::string inBuild = file && isPhoneFile(file) ? PHONE_IMAGE + std::string(file) : "";
  return real("elm_image_file_set", elm_image_file_set)(
      image, inBuild.empty() ? file : inBuild.c_str(), group);
}

void elm_image_file_get(const Evas_Object* image, const char** file, const char** group) {
  if (group) *group = nullptr;
  if (file) *file = static_cast<const char*>(evas_object_data_get(image, "test_file"));
}

void elm_gengrid_realized_items_update(Evas_Object* grid) {
  ++platform().gridRefreshes;
  real("elm_gengrid_realized_items_update", elm_gengrid_realized_items_update)(grid);
}

}  // extern "C"

ZQVSharedFiles::ZQVSharedFiles(const char* file) : _file(file) {}

ZQVSharedFiles& ZQVSharedFiles::getInstance() {
  static ZQVSharedFiles instance;
  return instance;
}

ZQVOwnedText ZQVSharedFiles::pathOf(const char* url) {
  const auto found = platform().recordedFiles.find(url);
  if (found == platform().recordedFiles.end()) return nullptr;
  return ZQVOwnedText(g_strdup(found->second.c_str()));
}
