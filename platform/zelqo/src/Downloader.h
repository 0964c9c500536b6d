/// Fetches pictures: a queue, a few at a time, again after a break when it looks worth it.
#pragma once

#include <list>
#include <set>
#include <string>
#include <vector>

#include "HttpFetch.h"
#include "zelqo.h"

namespace zelqo {

class Downloader {
 public:
  struct Options {
    int connections = 6;
    guint inactivityS = 15;
    HttpFetch::Limits limits;
    int retries = 3;
    guint firstPauseMs = 500;  ///< doubles with every retry
  };
  struct Order {
    std::vector<std::string> urls;
    std::string folder;
    zelqo_download_cb callback = nullptr;
    void* userData = nullptr;
  };

  explicit Downloader(const Options& options);
  ~Downloader();
  Downloader(const Downloader&) = delete;
  Downloader& operator=(const Downloader&) = delete;

  static Downloader& instance();

  /// Callbacks come later, from the main loop.
  void add(Order order);

 private:
  struct Batch;
  struct Job;
  struct Transfer;
  struct Saving;

  static gboolean pumpCb(gpointer self);
  static gboolean retryCb(gpointer job);
  void schedulePump();
  void pump();
  void start(Job job);
  void transferred(Transfer& transfer, const HttpFetch::Outcome& outcome);
  void save(Transfer& transfer);
  static void saveInThread(GTask* task, gpointer, gpointer saving, GCancellable*);
  static void savedCb(GObject*, GAsyncResult* result, gpointer);
  void saved(Transfer& transfer, const Saving& saving);
  Job take(Transfer& transfer);
  void failed(const Job& job, int error, const std::string& reason);
  void retryLater(Job job);
  static void report(const Job& job, int error, const char* path);

  const Options _options;
  SessionOwner _session;
  std::list<Job> _waiting;
  std::list<Transfer> _active;  ///< fetched, then saved
  int _fetching = 0;
  std::list<Job> _pausing;  ///< each with its timer
  std::set<std::string> _cleaned;
  unsigned int _lastRequest = 0;
  guint _pump = 0;
  std::shared_ptr<Downloader*> _self;  ///< what is saved may be there when this is long gone
};

}  // namespace zelqo
