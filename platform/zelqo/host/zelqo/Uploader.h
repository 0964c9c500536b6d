/// Sends files as a subscriber. One share at a time; everything comes on the main loop.
#pragma once

#include <zelqo/Share.h>
#include <zelqo/Store.h>

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace zelqo {

class Account;
class ServiceClient;

class Uploader {
 public:
  struct Request {
    std::string from;  ///< signed up when it has not been yet
    std::vector<std::string> to;
    std::vector<std::string> paths;
    bool single = false;
    std::int64_t lifetimeS = std::int64_t{14} * 24 * 3600;
    /// JSON text of a "files" array to be announced instead of what the paths are; for tests of
    /// what other phones do with odd shares.
    std::string rawFiles;
  };
  struct Result {
    int error = 0;       ///< 0 or one of zelqo_error_e
    std::string reason;  ///< of an error
    std::string token;
    std::int64_t requestId = 0;
    std::int64_t expiresMs = 0;
  };
  using ProgressCb = std::function<void(std::int64_t sentBytes, std::int64_t totalBytes)>;
  using DoneCb = std::function<void(const Result&)>;

  /// At the service of the phone's settings when `serviceUrl` is empty. The store outlives this.
  explicit Uploader(Store& store, const std::string& serviceUrl = {});
  /// Ends what is going on without a word.
  ~Uploader();
  Uploader(const Uploader&) = delete;
  Uploader& operator=(const Uploader&) = delete;

  /// `done` comes once, when the recipients can have it; never from within this call. A share of
  /// the phone's own number is then in the store. False while another one is going on.
  bool start(Request request, ProgressCb progress, DoneCb done);

 private:
  struct File {
    std::string path;
    std::string name;
    std::string type;
    std::int64_t size = 0;
  };

  static int beginCb(void* self);
  void begin();
  bool checkRequest();
  bool readFiles();
  void signUp();
  void announce();
  void announced(const std::string& body);
  std::string announcement() const;
  void sendNext();
  void complete();
  void keep();
  void fail(int error, const std::string& reason);
  void finish();

  Store& _store;
  std::string _serviceUrl;
  std::unique_ptr<ServiceClient> _client;
  std::unique_ptr<Account> _account;
  Request _request;
  ProgressCb _progress;
  DoneCb _done;
  Result _result;
  std::vector<File> _files;
  std::size_t _next = 0;
  std::int64_t _sent = 0;
  std::int64_t _total = 0;
  std::int64_t _createdMs = 0;
  bool _renewed = false;  ///< the key, for this share
  bool _busy = false;
  unsigned int _start = 0;
};

}  // namespace zelqo
