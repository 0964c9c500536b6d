/// Watches the viewer's main loop from outside, through the screen.
#pragma once

#include <gio/gio.h>

#include <chrono>
#include <memory>
#include <string>

class LoopWatch {
 public:
  LoopWatch();
  ~LoopWatch();
  LoopWatch(const LoopWatch&) = delete;
  LoopWatch& operator=(const LoopWatch&) = delete;

  /// Forgets what was measured before.
  void begin();
  /// Waits until the viewer has done what it was asked to do so far: "answers", "gone" or, when
  /// neither comes true, "silent".
  std::string settle(std::chrono::milliseconds patience = std::chrono::seconds(10));
  /// As settle(), and then waits until the screen stands still. Asks nobody but the screen.
  std::string rest(std::chrono::milliseconds patience = std::chrono::seconds(10));
  /// Runs a command in the phone's shell.
  void run(const std::string& command);
  void tap(const std::string& place);
  void key(const std::string& name);
  /// The longest time since begin() in which the main loop answered nobody and did nothing either.
  std::chrono::milliseconds longestWait();

 private:
  struct Release {
    void operator()(void* object) const { g_object_unref(object); }
  };
  std::string ask(const std::string& order);

  std::unique_ptr<GSubprocess, Release> _process;
  std::unique_ptr<GDataInputStream, Release> _answers;
};
