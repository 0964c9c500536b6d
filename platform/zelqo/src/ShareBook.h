/// The handles that this process has given out: one per share, never taken back, renewed from the
/// store each time they are asked for.
#pragma once

#include <map>
#include <memory>
#include <string>
#include <unordered_map>

#include "ReceivedHandle.h"
#include "SentHandle.h"
#include "StableTexts.h"
#include "zelqo.h"
#include "zelqo/Store.h"

namespace zelqo {

class ShareBook {
 public:
  static ShareBook& instance();

  zelqo_error_e openReceived(const std::string& token, zelqo_share_h& handle);
  zelqo_error_e openSent(int requestId, zelqo_share_h& handle);

  /// Null for what is not a handle of that kind.
  ReceivedHandle* received(zelqo_share_h handle);
  SentHandle* sent(zelqo_share_h handle);
  /// The file, read again when its share has been idle; null when there is none of that index.
  const ReceivedFile* file(ReceivedHandle& handle, unsigned int index);

  Store& store() { return _store; }

 private:
  bool renew(ReceivedHandle& handle, const std::string& token);

  Store _store;
  StableTexts _texts;
  std::map<std::string, std::unique_ptr<ReceivedHandle>> _receivedByToken;
  std::map<int, std::unique_ptr<SentHandle>> _sentById;
  std::unordered_map<zelqo_share_h, ReceivedHandle*> _received;
  std::unordered_map<zelqo_share_h, SentHandle*> _sent;
};

}  // namespace zelqo
