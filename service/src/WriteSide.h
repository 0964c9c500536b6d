/// What subscribers do: sign up, share, recall, and wait for news.
#pragma once

#include <libsoup/soup.h>

#include <list>
#include <string>
#include <utility>
#include <vector>

#include "BlobStore.h"
#include "Catalog.h"
#include "HttpAnswer.h"
#include "PushHub.h"
#include "ShareDesk.h"

namespace service {

class WriteSide {
 public:
  using Words = std::vector<std::string>;

  /// Only a lenient one takes shares with gaps and addresses of their own.
  WriteSide(Catalog& catalog, BlobStore& blobs, PushHub& hub, ShareDesk& desk, bool lenient);

  /// Before the body is read: who may not upload is told so now, and bodies are bounded.
  void prepare(SoupServerMessage* message, const Words& path);
  /// True when the answer is there on return, false when it follows.
  bool answer(SoupServerMessage* message, const Words& path, GHashTable* query);

 private:
  bool answerShares(SoupServerMessage* message, const Words& path);
  void prepareUpload(SoupServerMessage* message, const Words& path);
  void create(SoupServerMessage* message);
  void upload(SoupServerMessage* message, const Share& share, std::int64_t index);
  bool complete(SoupServerMessage* message, const Share& share);
  void recall(SoupServerMessage* message, const Share& share);
  bool push(SoupServerMessage* message, GHashTable* query);
  void signUp(SoupServerMessage* message);
  void sharingStatus(SoupServerMessage* message, const std::string& msisdn);

  /// The share of the address when it is the caller's own; otherwise answers and gives nothing.
  std::optional<Share> ownShare(SoupServerMessage* message, const std::string& id);
  void publishedCb(std::int64_t id);

  Catalog& _catalog;
  BlobStore& _blobs;
  PushHub& _hub;
  ShareDesk& _desk;
  bool _lenient;
  std::list<std::pair<std::int64_t, HeldRequest>> _waiting;  ///< for publication, by share
};

}  // namespace service
