#include <base/Fault.h>
#include <common/Owned.h>
#include <contacts.h>

#include <cstring>

#include "Filter.h"
#include "Person.h"

namespace contacts {
namespace {

bool isNumber(unsigned int property) {
  const auto& view = _contacts_person_number;
  return property == view.number || property == view.number_filter ||
         property == view.normalized_number || property == view.cleaned_number;
}

std::string folded(const std::string& text) {
  const common::OwnedText fold(g_utf8_casefold(text.c_str(), -1));
  return fold.get();
}

bool compare(contacts_match_str_flag_e match, const std::string& stored,
             const std::string& wanted) {
  switch (match) {
    case CONTACTS_MATCH_EXACTLY:
    case CONTACTS_MATCH_FULLSTRING:
      return stored == wanted;
    case CONTACTS_MATCH_CONTAINS:
      return stored.find(wanted) != std::string::npos;
    case CONTACTS_MATCH_STARTSWITH:
      return stored.compare(0, wanted.size(), wanted) == 0;
    case CONTACTS_MATCH_ENDSWITH:
      return stored.size() >= wanted.size() &&
             stored.compare(stored.size() - wanted.size(), wanted.size(), wanted) == 0;
    case CONTACTS_MATCH_EXISTS:
      return true;
  }
  return false;
}

}  // namespace

std::optional<View> viewOf(const char* uri) {
  if (uri && strcmp(uri, _contacts_person._uri) == 0) return View::Person;
  if (uri && strcmp(uri, _contacts_person_number._uri) == 0) return View::Number;
  return std::nullopt;
}

bool matches(const Condition& condition, const contacts_record_s& record) {
  const bool number = isNumber(condition.property);
  const std::string* stored =
      record.text(number ? _contacts_person_number.number : condition.property);
  if (!stored || condition.match == CONTACTS_MATCH_EXISTS) return stored != nullptr;
  if (number) {
    const std::string wanted = digitsOf(condition.value);
    // A text without digits is no number, and must not match everybody.
    return !wanted.empty() && compare(condition.match, digitsOf(*stored), wanted);
  }
  if (condition.match == CONTACTS_MATCH_EXACTLY) return *stored == condition.value;
  return compare(condition.match, folded(*stored), folded(condition.value));
}

}  // namespace contacts

bool contacts_filter_s::matches(const contacts_record_s& record) const {
  for (const auto& group : groups) {
    bool all = true;
    for (const auto& condition : group) all = all && contacts::matches(condition, record);
    if (all) return true;
  }
  return false;
}

int contacts_filter_create(const char* view_uri, contacts_filter_h* filter) {
  if (base::strikes(__func__)) return CONTACTS_ERROR_OUT_OF_MEMORY;
  const auto view = contacts::viewOf(view_uri);
  if (!filter || !view) return CONTACTS_ERROR_INVALID_PARAMETER;
  *filter = new contacts_filter_s{*view};
  return CONTACTS_ERROR_NONE;
}

int contacts_filter_destroy(contacts_filter_h filter) {
  if (!filter) return CONTACTS_ERROR_INVALID_PARAMETER;
  delete filter;
  return CONTACTS_ERROR_NONE;
}

int contacts_filter_add_str(contacts_filter_h filter, unsigned int property_id,
                            contacts_match_str_flag_e match, const char* match_value) {
  if (base::strikes(__func__)) return CONTACTS_ERROR_OUT_OF_MEMORY;
  const bool known = match >= CONTACTS_MATCH_EXACTLY && match <= CONTACTS_MATCH_EXISTS;
  const bool valid =
      match == CONTACTS_MATCH_EXISTS || (match_value && g_utf8_validate(match_value, -1, nullptr));
  if (!filter || !filter->expectsCondition || !known || !valid) {
    return CONTACTS_ERROR_INVALID_PARAMETER;
  }
  filter->groups.back().push_back({property_id, match, match_value ? match_value : ""});
  filter->expectsCondition = false;
  return CONTACTS_ERROR_NONE;
}

int contacts_filter_add_operator(contacts_filter_h filter,
                                 contacts_filter_operator_e operator_type) {
  if (!filter || filter->expectsCondition) return CONTACTS_ERROR_INVALID_PARAMETER;
  if (operator_type == CONTACTS_FILTER_OPERATOR_OR) {
    filter->groups.emplace_back();
  } else if (operator_type != CONTACTS_FILTER_OPERATOR_AND) {
    return CONTACTS_ERROR_INVALID_PARAMETER;
  }
  filter->expectsCondition = true;
  return CONTACTS_ERROR_NONE;
}
