/// One contact as the index keeps it.
#pragma once

#include <libebook/libebook.h>

#include <string>
#include <vector>

namespace contacts {

struct Person {
  int id = 0;  ///< of this process
  std::string name;
  std::string picture;               ///< absolute path, empty without one
  std::vector<std::string> numbers;  ///< as they were entered
  bool hasMail = false;
};

/// Everything but the id.
Person readPerson(EContact* contact);

/// The digits, after a plus when that comes first: how numbers are compared.
std::string digitsOf(const std::string& number);

}  // namespace contacts
