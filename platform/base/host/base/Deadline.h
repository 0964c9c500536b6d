/// Cancels a synchronous call that takes too long. The main loop cannot do that: it is waiting.
#pragma once

#include <common/Owned.h>

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <thread>

namespace base {

class Deadline {
 public:
  explicit Deadline(std::chrono::milliseconds time);
  ~Deadline();
  Deadline(const Deadline&) = delete;
  Deadline& operator=(const Deadline&) = delete;

  GCancellable* cancellable() const { return _cancellable.get(); }

 private:
  common::OwnedObject<GCancellable> _cancellable;
  std::mutex _mutex;
  std::condition_variable _done;
  bool _isDone = false;
  std::thread _watch;
};

}  // namespace base
