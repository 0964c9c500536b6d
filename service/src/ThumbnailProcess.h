/// One running thumbnail program. Pictures and videos of strangers are decoded there: what crashes,
/// hangs or eats memory on a crafted file is not the service.
#pragma once

#include <string>
#include <utility>

#include "Owned.h"
#include "ThumbnailJob.h"

namespace service {

class ThumbnailProcess {
 public:
  explicit ThumbnailProcess(std::string program) : _program(std::move(program)) {}
  ~ThumbnailProcess();
  ThumbnailProcess(const ThumbnailProcess&) = delete;
  ThumbnailProcess& operator=(const ThumbnailProcess&) = delete;

  /// Blocks until the pictures are made or have turned out impossible, false for the latter, or
  /// until cancelled.
  bool run(const ThumbnailJob& job, GCancellable* cancellable);

 private:
  bool start();
  bool send(const ThumbnailJob& job);
  bool awaitAnswer(GCancellable* cancellable);
  void stop();

  std::string _program;
  Ref<GSubprocess> _process;
};

}  // namespace service
