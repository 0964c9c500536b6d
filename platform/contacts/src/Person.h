/// One contact as the index keeps it, and as it travels over the bus.
#pragma once

#include <common/Owned.h>

#include <string>
#include <vector>

namespace contacts {

constexpr const char* kServiceName = "phone.Contacts";
constexpr const char* kServicePath = "/phone/Contacts";
constexpr const char* kServiceInterface = "phone.Contacts1";
constexpr const char* kPersonsType = "(a(issasb))";

struct Person {
  int id = 0;  ///< of the service's run
  std::string name;
  std::string picture;               ///< absolute path, empty without one
  std::vector<std::string> numbers;  ///< as they were entered
  bool hasMail = false;
};

/// Floating, of kPersonsType. Texts that are not valid UTF-8 travel as what is left of them.
GVariant* toVariant(const std::vector<Person>& persons);
std::vector<Person> fromVariant(GVariant* persons);

/// The digits, after a plus when that comes first: how numbers are compared.
std::string digitsOf(const std::string& number);

}  // namespace contacts
