/// Records and lists of records, behind the handles of the interface.
#pragma once

#include <contacts.h>

#include <map>
#include <memory>
#include <string>
#include <vector>

struct contacts_record_s {
  std::map<unsigned int, std::string> texts;  ///< an unset property is not there
  std::map<unsigned int, int> numbers;

  /// Null when the property is not set.
  const std::string* text(unsigned int property) const {
    const auto found = texts.find(property);
    return found == texts.end() ? nullptr : &found->second;
  }
};

struct contacts_list_s {
  std::vector<std::unique_ptr<contacts_record_s>> records;
  size_t current = 0;
};
