/// The phone's address book. All calls answer 0 or one of contacts_error_e, and read an index in
/// this process: none but contacts_connect waits for another process.
#pragma once

#include <contacts_views.h>
#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef struct contacts_filter_s* contacts_filter_h;
typedef struct contacts_query_s* contacts_query_h;
typedef struct contacts_list_s* contacts_list_h;
typedef struct contacts_record_s* contacts_record_h;

typedef enum {
  CONTACTS_ERROR_NONE = TIZEN_ERROR_NONE,
  CONTACTS_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
  CONTACTS_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
  CONTACTS_ERROR_FILE_NO_SPACE = TIZEN_ERROR_FILE_NO_SPACE_ON_DEVICE,
  CONTACTS_ERROR_PERMISSION_DENIED = TIZEN_ERROR_PERMISSION_DENIED,
  CONTACTS_ERROR_NOT_SUPPORTED = TIZEN_ERROR_NOT_SUPPORTED,
  CONTACTS_ERROR_NO_DATA = TIZEN_ERROR_NO_DATA,
  CONTACTS_ERROR_DB_LOCKED = -33619839,
  CONTACTS_ERROR_DB = -33619809,
  CONTACTS_ERROR_IPC_NOT_AVALIABLE = -33619791,
  CONTACTS_ERROR_IPC = -33619777,
  CONTACTS_ERROR_SYSTEM = -33619729,
  CONTACTS_ERROR_INTERNAL = -33619713
} contacts_error_e;

/// All but the first ignore case. Numbers are compared by their digits and a leading plus.
typedef enum {
  CONTACTS_MATCH_EXACTLY,
  CONTACTS_MATCH_FULLSTRING,
  CONTACTS_MATCH_CONTAINS,
  CONTACTS_MATCH_STARTSWITH,
  CONTACTS_MATCH_ENDSWITH,
  CONTACTS_MATCH_EXISTS
} contacts_match_str_flag_e;

typedef enum {
  CONTACTS_MATCH_EQUAL,
  CONTACTS_MATCH_GREATER_THAN,
  CONTACTS_MATCH_GREATER_THAN_OR_EQUAL,
  CONTACTS_MATCH_LESS_THAN,
  CONTACTS_MATCH_LESS_THAN_OR_EQUAL,
  CONTACTS_MATCH_NOT_EQUAL,
  CONTACTS_MATCH_NONE
} contacts_match_int_flag_e;

typedef enum {
  CONTACTS_FILTER_OPERATOR_AND,
  CONTACTS_FILTER_OPERATOR_OR
} contacts_filter_operator_e;

typedef enum {
  CONTACTS_CHANGE_INSERTED,
  CONTACTS_CHANGE_UPDATED,
  CONTACTS_CHANGE_DELETED
} contacts_changed_e;

/// On the main loop, once for all changes that came while it was busy.
typedef void (*contacts_db_changed_cb)(const char* view_uri, void* user_data);

/// Counted: the last disconnect closes. Waits for the address book a moment at the most; one that
/// needs longer is a change when it comes.
int contacts_connect(void);
/// CONTACTS_ERROR_DB without a connection.
int contacts_disconnect(void);

/// CONTACTS_ERROR_DB without a connection.
int contacts_db_add_changed_cb(const char* view_uri, contacts_db_changed_cb callback,
                               void* user_data);
/// The callback and the data of the registration; CONTACTS_ERROR_NO_DATA when there is none.
int contacts_db_remove_changed_cb(const char* view_uri, contacts_db_changed_cb callback,
                                  void* user_data);

/// Limit 0 means all. No match is success with an empty list, which the caller destroys.
int contacts_db_get_records_with_query(contacts_query_h query, int offset, int limit,
                                       contacts_list_h* record_list);
int contacts_db_get_all_records(const char* view_uri, int offset, int limit,
                                contacts_list_h* record_list);

int contacts_filter_create(const char* view_uri, contacts_filter_h* filter);
int contacts_filter_destroy(contacts_filter_h filter);
/// Conditions and operators take turns; "and" binds tighter than "or".
int contacts_filter_add_str(contacts_filter_h filter, unsigned int property_id,
                            contacts_match_str_flag_e match, const char* match_value);
int contacts_filter_add_operator(contacts_filter_h filter,
                                 contacts_filter_operator_e operator_type);

int contacts_query_create(const char* view_uri, contacts_query_h* query);
int contacts_query_destroy(contacts_query_h query);
/// The query takes a copy; the filter stays the caller's.
int contacts_query_set_filter(contacts_query_h query, contacts_filter_h filter);
int contacts_query_set_projection(contacts_query_h query, unsigned int property_id_array[],
                                  int count);
int contacts_query_set_sort(contacts_query_h query, unsigned int property_id, bool is_ascending);

/// A new list stands on its first record. Beyond either end: CONTACTS_ERROR_NO_DATA.
int contacts_list_get_count(contacts_list_h list, int* count);
int contacts_list_first(contacts_list_h list);
int contacts_list_last(contacts_list_h list);
int contacts_list_next(contacts_list_h list);
int contacts_list_prev(contacts_list_h list);
/// The record is the list's.
int contacts_list_get_current_record_p(contacts_list_h list, contacts_record_h* record);
/// Without `delete_child` the records live on and are the caller's.
int contacts_list_destroy(contacts_list_h list, bool delete_child);

/// The text is the record's; null when the property is not set.
int contacts_record_get_str_p(contacts_record_h record, unsigned int property_id, char** value);
/// A copy, to be freed with free().
int contacts_record_get_str(contacts_record_h record, unsigned int property_id, char** value);
int contacts_record_get_int(contacts_record_h record, unsigned int property_id, int* value);
int contacts_record_destroy(contacts_record_h record, bool delete_child);

#ifdef __cplusplus
}
#endif
