/// Texts handed out once and for all; few and short: phone numbers.
#pragma once

#include <set>
#include <string>

namespace zelqo {

class StableTexts {
 public:
  /// The same text always gives the same pointer, valid as long as this object.
  char* keep(const std::string& text) {
    return const_cast<char*>(_texts.insert(text).first->c_str());
  }

 private:
  std::set<std::string> _texts;
};

}  // namespace zelqo
