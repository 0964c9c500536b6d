/// A sent share as the library's users hold it.
#pragma once

#include <deque>
#include <string>
#include <vector>

#include "StableTexts.h"
#include "zelqo.h"
#include "zelqo/Share.h"

namespace zelqo {

class SentHandle {
 public:
  void set(SentShare share, StableTexts& texts);

  const std::vector<std::string>& paths() const { return _paths; }
  zelqo_recipient_s** recipients() { return _lists.back().pointers.data(); }
  std::size_t recipientCount() const { return _recipients.size(); }

 private:
  struct List {
    std::vector<zelqo_recipient_s> records;
    std::vector<zelqo_recipient_s*> pointers;
  };

  std::vector<std::string> _paths;
  std::vector<std::string> _recipients;
  std::deque<List> _lists;  ///< earlier ones stay, callers may still read them
};

}  // namespace zelqo
