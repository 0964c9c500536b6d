#include "Companions.h"

#include <fstream>
#include <iterator>

#include "User.h"

using phone::thePhone;

void open(const char* application) {
  thePhone()({"launch", "raw", "default", "--app", application});
}

testing::AssertionResult comes(const std::string& name) {
  return phone::comes(thePhone(), name);
}

testing::AssertionResult goes(const std::string& name) {
  return phone::goes(thePhone(), name);
}

testing::AssertionResult tap(const std::string& name) {
  return phone::tap(thePhone(), name);
}

testing::AssertionResult says(const std::string& text) {
  return phone::says(thePhone(), text);
}

std::string contentOf(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

std::string ofPhone(const std::string& path) {
  return thePhone().folder() + "/opt-usr" + path.substr(std::string("/opt/usr").size());
}
