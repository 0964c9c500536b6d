/// Where controllers go to end: after the handler that asked for it has returned to the main loop.
#pragma once

#include <Ecore.h>

#include <memory>
#include <vector>

namespace app_assist {

class WViewController;

class LateDestroyer {
 public:
  static LateDestroyer& instance();

  /// The controller ends in a later pass of the main loop: its view object first, then itself.
  void add(std::unique_ptr<WViewController> controller);
  /// Ends all of them now. Not for handlers of one of them.
  void flush();

 private:
  static void jobCb(void* data);

  std::vector<std::unique_ptr<WViewController>> _waiting;
  Ecore_Job* _job = nullptr;
};

}  // namespace app_assist
