#include "ShareBook.h"

#include "zelqo/PhoneSettings.h"

namespace zelqo {

ShareBook& ShareBook::instance() {
  static ShareBook book;
  return book;
}

bool ShareBook::renew(ReceivedHandle& handle, const std::string& token) {
  auto share = _store.received(token);
  if (!share) return false;
  char* sender = _texts.keep(share->sender);
  handle.set(std::move(*share), sender, serviceUrl());
  return true;
}

zelqo_error_e ShareBook::openReceived(const std::string& token, zelqo_share_h& handle) {
  if (!_store.usable()) return ZELQO_ERROR_STORE;
  // Only the files of the share that is looked at stay in memory.
  for (const auto& entry : _received) entry.second->dropFiles();
  const auto known = _receivedByToken.find(token);
  auto fresh = known == _receivedByToken.end() ? std::make_unique<ReceivedHandle>() : nullptr;
  ReceivedHandle* share = fresh ? fresh.get() : known->second.get();
  if (!renew(*share, token)) return ZELQO_ERROR_NO_DATA;
  if (fresh) _receivedByToken[token] = std::move(fresh);
  handle = reinterpret_cast<zelqo_share_h>(share);
  _received[handle] = share;
  return ZELQO_ERROR_NONE;
}

zelqo_error_e ShareBook::openSent(int requestId, zelqo_share_h& handle) {
  if (!_store.usable()) return ZELQO_ERROR_STORE;
  auto share = _store.sent(requestId);
  if (!share) return ZELQO_ERROR_NO_DATA;
  auto& entry = _sentById[requestId];
  if (!entry) entry = std::make_unique<SentHandle>();
  entry->set(std::move(*share), _texts);
  handle = reinterpret_cast<zelqo_share_h>(entry.get());
  _sent[handle] = entry.get();
  return ZELQO_ERROR_NONE;
}

ReceivedHandle* ShareBook::received(zelqo_share_h handle) {
  const auto found = _received.find(handle);
  return found == _received.end() ? nullptr : found->second;
}

SentHandle* ShareBook::sent(zelqo_share_h handle) {
  const auto found = _sent.find(handle);
  return found == _sent.end() ? nullptr : found->second;
}

const ReceivedFile* ShareBook::file(ReceivedHandle& handle, unsigned int index) {
  if (index >= handle.fileCount()) return nullptr;
  if (!handle.hasFiles() && !renew(handle, handle.token())) return nullptr;
  return index < handle.fileCount() ? &handle.file(index) : nullptr;
}

}  // namespace zelqo
