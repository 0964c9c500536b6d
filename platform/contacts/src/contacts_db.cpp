#include <base/Fault.h>
#include <common/Owned.h>
#include <contacts.h>

#include <algorithm>
#include <clocale>
#include <memory>

#include "Filter.h"
#include "PersonIndex.h"
#include "Record.h"

namespace {

using contacts::Person;
using contacts::PersonIndex;
using contacts::View;

struct Callback {
  View view;
  contacts_db_changed_cb function;
  void* data;

  bool operator==(const Callback& other) const {
    return view == other.view && function == other.function && data == other.data;
  }
};

struct Connection {
  int users = 0;
  std::unique_ptr<PersonIndex> index;
  std::vector<Callback> callbacks;
};

Connection& connection() {
  static Connection theOne;
  return theOne;
}

const char* uriOf(View view) {
  return view == View::Person ? _contacts_person._uri : _contacts_person_number._uri;
}

/// Callbacks may remove themselves and others, and disconnect.
void tellAll() {
  const std::vector<Callback> callbacks = connection().callbacks;
  for (const auto& callback : callbacks) {
    const auto& current = connection().callbacks;
    if (std::find(current.begin(), current.end(), callback) == current.end()) continue;
    callback.function(uriOf(callback.view), callback.data);
  }
}

using Record = std::unique_ptr<contacts_record_s>;
using Records = std::vector<Record>;

void setText(contacts_record_s& record, unsigned int property, const std::string& text) {
  if (!text.empty()) record.texts[property] = text;
}

/// What the two views have in common.
template <typename Properties>
Record common(const Properties& view, unsigned int id, const Person& person) {
  auto record = std::make_unique<contacts_record_s>();
  record->numbers[id] = person.id;
  record->numbers[view.display_contact_id] = person.id;
  record->numbers[view.is_favorite] = 0;
  record->numbers[view.has_phonenumber] = !person.numbers.empty();
  record->numbers[view.has_email] = person.hasMail;
  setText(*record, view.display_name, person.name);
  setText(*record, view.image_thumbnail_path, person.picture);
  return record;
}

void addNumbers(Records& records, const Person& person) {
  const auto& view = _contacts_person_number;
  for (size_t i = 0; i < person.numbers.size(); i++) {
    Record record = common(view, view.person_id, person);
    record->numbers[view.number_id] = static_cast<int>(i) + 1;
    record->numbers[view.is_primary_default] = i == 0;
    const std::string digits = contacts::digitsOf(person.numbers[i]);
    setText(*record, view.number, person.numbers[i]);
    setText(*record, view.normalized_number, digits);
    setText(*record, view.cleaned_number, digits);
    records.push_back(std::move(record));
  }
}

Records allRecords(View view) {
  Records records;
  for (const Person& person : connection().index->persons()) {
    if (view == View::Person) {
      records.push_back(common(_contacts_person, _contacts_person.id, person));
    } else {
      addNumbers(records, person);
    }
  }
  return records;
}

bool comesBefore(const contacts_record_s& one, const contacts_record_s& other,
                 unsigned int property) {
  const std::string *first = one.text(property), *second = other.text(property);
  if (first && second) return g_utf8_collate(first->c_str(), second->c_str()) < 0;
  return first && !second;  // what has no text comes last
}

/// The order is that of the language; applications have it only when they ask for it.
void sortRecords(Records& records, const std::pair<unsigned int, bool>& sort) {
  setlocale(LC_COLLATE, setlocale(LC_MESSAGES, nullptr));
  std::stable_sort(records.begin(), records.end(), [&](const Record& one, const Record& other) {
    return sort.second ? comesBefore(*one, *other, sort.first)
                       : comesBefore(*other, *one, sort.first);
  });
}

void project(contacts_record_s& record, const std::vector<unsigned int>& properties) {
  const auto unwanted = [&](unsigned int property) {
    return std::find(properties.begin(), properties.end(), property) == properties.end();
  };
  for (auto it = record.texts.begin(); it != record.texts.end();) {
    it = unwanted(it->first) ? record.texts.erase(it) : std::next(it);
  }
  for (auto it = record.numbers.begin(); it != record.numbers.end();) {
    it = unwanted(it->first) ? record.numbers.erase(it) : std::next(it);
  }
}

int answer(Records records, int offset, int limit, contacts_list_h* list) {
  const size_t first = std::min(records.size(), static_cast<size_t>(offset));
  const size_t rest = records.size() - first;
  const size_t count = limit == 0 ? rest : std::min(rest, static_cast<size_t>(limit));
  auto result = std::make_unique<contacts_list_s>();
  const auto begin = std::next(records.begin(), static_cast<std::ptrdiff_t>(first));
  std::move(begin, std::next(begin, static_cast<std::ptrdiff_t>(count)),
            std::back_inserter(result->records));
  *list = result.release();
  return CONTACTS_ERROR_NONE;
}

}  // namespace

int contacts_connect(void) {
  if (base::strikes(__func__)) return CONTACTS_ERROR_IPC_NOT_AVALIABLE;
  Connection& current = connection();
  if (current.users == 0) {
    auto index = std::make_unique<PersonIndex>(tellAll);
    if (!index->open()) return CONTACTS_ERROR_IPC_NOT_AVALIABLE;
    current.index = std::move(index);
  }
  current.users++;
  return CONTACTS_ERROR_NONE;
}

int contacts_disconnect(void) {
  if (base::strikes(__func__)) return CONTACTS_ERROR_DB;
  Connection& current = connection();
  if (current.users == 0) return CONTACTS_ERROR_DB;
  if (--current.users == 0) {
    current.index.reset();
    current.callbacks.clear();
  }
  return CONTACTS_ERROR_NONE;
}

int contacts_db_add_changed_cb(const char* view_uri, contacts_db_changed_cb callback,
                               void* user_data) {
  if (base::strikes(__func__)) return CONTACTS_ERROR_DB;
  const auto view = contacts::viewOf(view_uri);
  if (!view || !callback) return CONTACTS_ERROR_INVALID_PARAMETER;
  if (!connection().index) return CONTACTS_ERROR_DB;
  connection().callbacks.push_back({*view, callback, user_data});
  return CONTACTS_ERROR_NONE;
}

int contacts_db_remove_changed_cb(const char* view_uri, contacts_db_changed_cb callback,
                                  void* user_data) {
  if (base::strikes(__func__)) return CONTACTS_ERROR_NO_DATA;
  const auto view = contacts::viewOf(view_uri);
  if (!view || !callback) return CONTACTS_ERROR_INVALID_PARAMETER;
  auto& callbacks = connection().callbacks;
  const auto found =
      std::find(callbacks.begin(), callbacks.end(), Callback{*view, callback, user_data});
  if (found == callbacks.end()) return CONTACTS_ERROR_NO_DATA;
  callbacks.erase(found);
  return CONTACTS_ERROR_NONE;
}

int contacts_db_get_records_with_query(contacts_query_h query, int offset, int limit,
                                       contacts_list_h* record_list) {
  if (base::strikes(__func__)) return CONTACTS_ERROR_DB;
  if (!query || !record_list || offset < 0 || limit < 0) return CONTACTS_ERROR_INVALID_PARAMETER;
  *record_list = nullptr;
  if (!connection().index) return CONTACTS_ERROR_DB;
  Records records = allRecords(query->view);
  if (query->filter) {
    records.erase(
        std::remove_if(records.begin(), records.end(),
                       [&](const Record& record) { return !query->filter->matches(*record); }),
        records.end());
  }
  if (query->sort) sortRecords(records, *query->sort);
  if (!query->projection.empty()) {
    for (const auto& record : records) project(*record, query->projection);
  }
  return answer(std::move(records), offset, limit, record_list);
}

int contacts_db_get_all_records(const char* view_uri, int offset, int limit,
                                contacts_list_h* record_list) {
  const auto view = contacts::viewOf(view_uri);
  if (!view || !record_list || offset < 0 || limit < 0) return CONTACTS_ERROR_INVALID_PARAMETER;
  *record_list = nullptr;
  if (!connection().index) return CONTACTS_ERROR_DB;
  return answer(allRecords(*view), offset, limit, record_list);
}
