#include "companion/ContactBook.h"

#include <common/Owned.h>
#include <contacts.h>
#include <glib.h>

#include <algorithm>
#include <clocale>
#include <type_traits>

namespace companion {
namespace {

void destroyWithRecords(contacts_list_h list) {
  contacts_list_destroy(list, true);
}

using OwnedFilter =
    common::Owned<std::remove_pointer_t<contacts_filter_h>, contacts_filter_destroy>;
using OwnedQuery = common::Owned<std::remove_pointer_t<contacts_query_h>, contacts_query_destroy>;
using OwnedList = common::Owned<std::remove_pointer_t<contacts_list_h>, destroyWithRecords>;

const auto& kView = _contacts_person_number;

std::string textOf(contacts_record_h record, unsigned int property) {
  char* value = nullptr;
  contacts_record_get_str_p(record, property, &value);
  return value ? value : "";
}

std::vector<ContactBook::Entry> entriesOf(const OwnedList& list) {
  std::vector<ContactBook::Entry> entries;
  contacts_record_h record = nullptr;
  while (list && contacts_list_get_current_record_p(list.get(), &record) == CONTACTS_ERROR_NONE) {
    entries.push_back({textOf(record, kView.display_name), textOf(record, kView.number),
                       textOf(record, kView.image_thumbnail_path)});
    if (contacts_list_next(list.get()) != CONTACTS_ERROR_NONE) break;
  }
  return entries;
}

OwnedList recordsWith(const std::string& number) {
  contacts_filter_h rawFilter = nullptr;
  contacts_query_h rawQuery = nullptr;
  contacts_list_h rawList = nullptr;
  contacts_filter_create(kView._uri, &rawFilter);
  const OwnedFilter filter(rawFilter);
  contacts_query_create(kView._uri, &rawQuery);
  const OwnedQuery query(rawQuery);
  if (!filter || !query) return nullptr;
  contacts_filter_add_str(rawFilter, kView.number, CONTACTS_MATCH_CONTAINS, number.c_str());
  contacts_query_set_filter(rawQuery, rawFilter);
  contacts_db_get_records_with_query(rawQuery, 0, 0, &rawList);
  return OwnedList(rawList);
}

}  // namespace

ContactBook::ContactBook(std::function<void()> onChange) : _onChange(std::move(onChange)) {
  const int error = contacts_connect();
  if (error != CONTACTS_ERROR_NONE) g_warning("no address book: %d", error);
  contacts_db_add_changed_cb(_contacts_person._uri, _changedCb, this);
}

ContactBook::~ContactBook() {
  contacts_db_remove_changed_cb(_contacts_person._uri, _changedCb, this);
  contacts_disconnect();
}

void ContactBook::_changedCb(const char*, void* data) {
  const auto* book = static_cast<ContactBook*>(data);
  if (book->_onChange) book->_onChange();
}

std::string ContactBook::nameOf(const std::string& number) const {
  if (number.empty()) return {};
  for (const auto& entry : entriesOf(recordsWith(number))) {
    if (!entry.name.empty()) return entry.name;
  }
  return number;
}

std::vector<ContactBook::Entry> ContactBook::all() const {
  contacts_list_h raw = nullptr;
  contacts_db_get_all_records(kView._uri, 0, 0, &raw);
  auto entries = entriesOf(OwnedList(raw));
  entries.erase(std::remove_if(entries.begin(), entries.end(),
                               [](const Entry& entry) { return entry.number.empty(); }),
                entries.end());
  for (auto& entry : entries) {
    if (entry.name.empty()) entry.name = entry.number;
  }
  // An application has the order of its language only when it asks for it.
  setlocale(LC_COLLATE, setlocale(LC_MESSAGES, nullptr));
  std::sort(entries.begin(), entries.end(), [](const Entry& left, const Entry& right) {
    const int order = g_utf8_collate(left.name.c_str(), right.name.c_str());
    return order != 0 ? order < 0 : left.number < right.number;
  });
  return entries;
}

}  // namespace companion
