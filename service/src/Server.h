/// The sharing service on one address.
#pragma once

#include <libsoup/soup.h>

#include <list>
#include <string>
#include <vector>

#include "BlobStore.h"
#include "Catalog.h"
#include "HttpAnswer.h"
#include "PushHub.h"
#include "ReadSide.h"
#include "ShareDesk.h"
#include "Stats.h"
#include "WriteSide.h"

namespace service {

struct Options {
  std::string data;
  guint port = 0;  ///< 0: any
  std::string tlsCertificate;
  std::string tlsKey;
  std::string publicUrl;         ///< of the read side, when it is another server
  std::string thumbnailProgram;  ///< path
  guint delayMs = 0;             ///< every answer comes so much later
  bool refuse = false;           ///< every request is refused
  bool lenient = false;          ///< shares may have gaps and name addresses of their own
};

class Server {
 public:
  explicit Server(Options options);
  ~Server();
  Server(const Server&) = delete;
  Server& operator=(const Server&) = delete;

  /// False, with a log line, when the data folder or the port cannot be used.
  bool start();
  std::string url() const;

 private:
  static void headersReadCb(SoupServer*, SoupServerMessage* message, const char*, GHashTable*,
                            gpointer self);
  static void requestCb(SoupServer*, SoupServerMessage* message, const char*, GHashTable* query,
                        gpointer self);
  bool setUpTls();
  bool answer(SoupServerMessage* message, const std::vector<std::string>& path, GHashTable* query);
  void answerLater(SoupServerMessage* message, std::vector<std::string> path, GHashTable* query);
  void answerStats(SoupServerMessage* message) const;

  Options _options;
  Stats _stats;
  Catalog _catalog;
  BlobStore _blobs;
  PushHub _hub;
  ShareDesk _desk;
  ReadSide _readSide;
  WriteSide _writeSide;
  std::list<HeldRequest> _delayed;
  Ref<SoupServer> _server;
};

}  // namespace service
