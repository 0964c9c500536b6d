#include <contacts.h>

#include <base/Fault.h>
#include <cstring>

#include "Record.h"

namespace {

bool isTextProperty(unsigned int property) {
  const auto& person = _contacts_person;
  const auto& number = _contacts_person_number;
  for (const unsigned int text : {person.display_name,
                                  person.display_name_index,
                                  person.ringtone_path,
                                  person.image_thumbnail_path,
                                  person.vibration,
                                  person.status,
                                  person.addressbook_ids,
                                  person.message_alert,
                                  person.snippet_string,
                                  number.display_name,
                                  number.display_name_index,
                                  number.ringtone_path,
                                  number.image_thumbnail_path,
                                  number.vibration,
                                  number.label,
                                  number.number,
                                  number.normalized_number,
                                  number.message_alert,
                                  number.cleaned_number,
                                  number.snippet_string}) {
    if (property == text) return true;
  }
  return false;
}

int moveTo(contacts_list_h list, size_t index) {
  if (!list) return CONTACTS_ERROR_INVALID_PARAMETER;
  if (index >= list->records.size()) return CONTACTS_ERROR_NO_DATA;
  list->current = index;
  return CONTACTS_ERROR_NONE;
}

}  // namespace

int contacts_list_get_count(contacts_list_h list, int* count) {
  if (!list || !count) return CONTACTS_ERROR_INVALID_PARAMETER;
  *count = static_cast<int>(list->records.size());
  return CONTACTS_ERROR_NONE;
}

int contacts_list_first(contacts_list_h list) {
  return moveTo(list, 0);
}

int contacts_list_last(contacts_list_h list) {
  return moveTo(list, list && !list->records.empty() ? list->records.size() - 1 : 0);
}

int contacts_list_next(contacts_list_h list) {
  if (base::strikes(__func__)) return CONTACTS_ERROR_NO_DATA;
  return moveTo(list, list ? list->current + 1 : 0);
}

int contacts_list_prev(contacts_list_h list) {
  if (list && list->current == 0) return CONTACTS_ERROR_NO_DATA;
  return moveTo(list, list ? list->current - 1 : 0);
}

int contacts_list_get_current_record_p(contacts_list_h list, contacts_record_h* record) {
  if (base::strikes(__func__)) return CONTACTS_ERROR_NO_DATA;
  if (!list || !record) return CONTACTS_ERROR_INVALID_PARAMETER;
  *record = nullptr;
  if (list->current >= list->records.size()) return CONTACTS_ERROR_NO_DATA;
  *record = list->records[list->current].get();
  return CONTACTS_ERROR_NONE;
}

int contacts_list_destroy(contacts_list_h list, bool delete_child) {
  if (!list) return CONTACTS_ERROR_INVALID_PARAMETER;
  if (!delete_child) {
    for (auto& record : list->records) (void)record.release();  // the caller's from now on
  }
  delete list;
  return CONTACTS_ERROR_NONE;
}

int contacts_record_get_str_p(contacts_record_h record, unsigned int property_id, char** value) {
  if (base::strikes(__func__)) return CONTACTS_ERROR_NO_DATA;
  if (!record || !value) return CONTACTS_ERROR_INVALID_PARAMETER;
  *value = nullptr;
  if (!isTextProperty(property_id)) return CONTACTS_ERROR_INVALID_PARAMETER;
  const std::string* text = record->text(property_id);
  if (text) *value = const_cast<char*>(text->c_str());
  return CONTACTS_ERROR_NONE;
}

int contacts_record_get_str(contacts_record_h record, unsigned int property_id, char** value) {
  const int error = contacts_record_get_str_p(record, property_id, value);
  if (error == CONTACTS_ERROR_NONE && *value) *value = strdup(*value);
  return error;
}

int contacts_record_get_int(contacts_record_h record, unsigned int property_id, int* value) {
  if (!record || !value) return CONTACTS_ERROR_INVALID_PARAMETER;
  const auto found = record->numbers.find(property_id);
  if (found == record->numbers.end()) return CONTACTS_ERROR_INVALID_PARAMETER;
  *value = found->second;
  return CONTACTS_ERROR_NONE;
}

int contacts_record_destroy(contacts_record_h record, bool) {
  if (!record) return CONTACTS_ERROR_INVALID_PARAMETER;
  delete record;
  return CONTACTS_ERROR_NONE;
}
