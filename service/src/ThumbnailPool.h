/// Makes pictures of uploaded files in worker threads, each of which drives one thumbnail program.
#pragma once

#include <functional>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "Owned.h"
#include "ThumbnailJob.h"

namespace service {

class ThumbnailProcess;

class ThumbnailPool {
 public:
  explicit ThumbnailPool(std::string program);
  /// Drops what is waiting and ends what is running.
  ~ThumbnailPool();
  ThumbnailPool(const ThumbnailPool&) = delete;
  ThumbnailPool& operator=(const ThumbnailPool&) = delete;

  /// `done` runs on the main loop, whether or not there are pictures now.
  void add(ThumbnailJob job, std::function<void()> done);

 private:
  struct Work {
    ThumbnailJob job;
    std::function<void()> done;
    std::weak_ptr<bool> alive;
  };

  static void runCb(gpointer work, gpointer self);
  static gboolean doneCb(gpointer work);
  void run(const ThumbnailJob& job);
  std::unique_ptr<ThumbnailProcess> take();
  void giveBack(std::unique_ptr<ThumbnailProcess> process);

  std::string _program;
  std::shared_ptr<bool> _alive = std::make_shared<bool>(true);
  Ref<GCancellable> _cancellable{g_cancellable_new()};
  std::mutex _mutex;
  std::vector<std::unique_ptr<ThumbnailProcess>> _idle;
  GThreadPool* _threads;
};

}  // namespace service
