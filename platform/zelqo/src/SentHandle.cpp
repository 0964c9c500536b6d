#include "SentHandle.h"

#include <utility>

namespace zelqo {

void SentHandle::set(SentShare share, StableTexts& texts) {
  _paths = std::move(share.paths);
  if (!_lists.empty() && share.recipients == _recipients) return;
  _recipients = std::move(share.recipients);
  List& list = _lists.emplace_back();
  for (const std::string& number : _recipients) {
    const auto index = static_cast<unsigned int>(list.records.size());
    list.records.push_back({index, texts.keep(number)});
  }
  for (zelqo_recipient_s& record : list.records) list.pointers.push_back(&record);
}

}  // namespace zelqo
