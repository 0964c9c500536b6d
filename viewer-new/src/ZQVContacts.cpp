#include "ZQVContacts.h"

#include <contacts.h>

#include "ZQVLog.h"
#include "ZQVOwned.h"

namespace {

using Filter = ZQVOwned<std::remove_pointer_t<contacts_filter_h>, contacts_filter_destroy>;
using Query = ZQVOwned<std::remove_pointer_t<contacts_query_h>, contacts_query_destroy>;

void destroyWithRecords(contacts_list_h list) {
  contacts_list_destroy(list, true);
}
using Records = ZQVOwned<std::remove_pointer_t<contacts_list_h>, destroyWithRecords>;

/// Digits and a leading plus, as the contacts store numbers.
std::string dialled(const char* number) {
  std::string digits;
  for (const char* at = number ? number : ""; *at; ++at) {
    if (g_ascii_isdigit(*at) || (*at == '+' && digits.empty())) digits += *at;
  }
  return digits == "+" ? std::string() : digits;
}

/// Everybody whose number contains this one; null when the contacts cannot be asked.
Records findByNumber(const char* number) {
  Records records;
  const std::string wanted = dialled(number);
  if (wanted.empty()) return records;
  Filter filter;
  contacts_filter_create(_contacts_person_number._uri, filter.out());
  contacts_filter_add_str(filter.get(), _contacts_person_number.number, CONTACTS_MATCH_CONTAINS,
                          wanted.c_str());
  Query query;
  contacts_query_create(_contacts_person_number._uri, query.out());
  contacts_query_set_filter(query.get(), filter.get());
  const int result = contacts_db_get_records_with_query(query.get(), 0, 0, records.out());
  if (result != CONTACTS_ERROR_NONE) {
    ZQV_ERROR("contacts_db_get_records_with_query is failed error_code = %d", result);
    return nullptr;
  }
  return records;
}

/// A property of the record the list stands on; null when it is not set.
const char* currentText(const Records& records, unsigned int property) {
  contacts_record_h record = nullptr;
  char* text = nullptr;
  if (contacts_list_get_current_record_p(records.get(), &record) != CONTACTS_ERROR_NONE) {
    return nullptr;
  }
  contacts_record_get_str_p(record, property, &text);
  return text && *text ? text : nullptr;
}

}  // namespace

char* ZQVContacts::_getContactName(const char* number) {
  const Records records = findByNumber(number);
  if (!records) return nullptr;
  do {
    const char* name = currentText(records, _contacts_person_number.display_name);
    if (name) return g_strdup(name);
  } while (contacts_list_next(records.get()) == CONTACTS_ERROR_NONE);
  return nullptr;
}

std::string ZQVContacts::_getContactImagePath(const char* number) {
  std::string path;
  const Records records = findByNumber(number);
  if (!records) return path;
  do {
    const char* image = currentText(records, _contacts_person_number.image_thumbnail_path);
    if (image) path = image;
  } while (contacts_list_next(records.get()) == CONTACTS_ERROR_NONE);
  return path;
}

std::string ZQVContacts::nameOrNumber(const char* number) {
  const ZQVOwnedText name(_getContactName(number));
  if (name) return name.get();
  return number ? number : "";
}

std::string ZQVContacts::recipientsText(zelqo_recipient_s** recipients, uint32_t count) {
  std::string text;
  for (uint32_t i = 0; recipients && i < count; ++i) {
    if (i > 0) text += ",";
    text += nameOrNumber(recipients[i] ? recipients[i]->msisdn : nullptr);
  }
  return text;
}

std::string ZQVContacts::recipientsImage(zelqo_recipient_s** recipients, uint32_t count) {
  if (count > 1) return ZQV_GROUP_CALLER_IMAGE;
  const bool any = recipients && count == 1 && recipients[0];
  const std::string image = any ? _getContactImagePath(recipients[0]->msisdn) : std::string();
  return image.empty() ? ZQV_DEFAULT_CALLER_IMAGE : image;
}
