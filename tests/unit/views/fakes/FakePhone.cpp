#include "FakePhone.h"

FakePhone& FakePhone::get() {
  static FakePhone phone;
  return phone;
}

void FakePhone::reset() {
  *this = FakePhone();
}

std::vector<std::string> FakePhone::usageOf(const std::string& feature) const {
  std::vector<std::string> extras;
  for (const UsageRecord& record : usage) {
    std::string code;
    std::string extra = "(none)";
    for (const auto& [key, value] : record.entries) {
      if (key == "feature") code = value;
      if (key == "extra") extra = value;
    }
    if (code == feature) extras.push_back(extra);
  }
  return extras;
}

std::vector<std::string> Launch::extra(const std::string& key) const {
  for (const auto& [name, values] : extras) {
    if (name == key) return values;
  }
  return {};
}

std::vector<std::string> Launch::keys() const {
  std::vector<std::string> names;
  for (const auto& entry : extras) names.push_back(entry.first);
  return names;
}
