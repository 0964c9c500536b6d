/// Filters and queries, behind the handles of the interface.
#pragma once

#include <contacts.h>

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "Record.h"

namespace contacts {

enum class View { Person, Number };

/// Nothing for a text that names no view.
std::optional<View> viewOf(const char* uri);

struct Condition {
  unsigned int property;
  contacts_match_str_flag_e match;
  std::string value;
};

bool matches(const Condition& condition, const contacts_record_s& record);

}  // namespace contacts

struct contacts_filter_s {
  contacts::View view;
  /// Groups joined by "or", the conditions in each joined by "and".
  std::vector<std::vector<contacts::Condition>> groups{1};
  bool expectsCondition = true;

  bool matches(const contacts_record_s& record) const;
};

struct contacts_query_s {
  contacts::View view;
  std::optional<contacts_filter_s> filter;
  std::vector<unsigned int> projection;  ///< empty: all properties
  std::optional<std::pair<unsigned int, bool>> sort;
};
