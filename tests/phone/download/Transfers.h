/// Large files, and what stands between them and the phone.
#pragma once

#include <gio/gio.h>
#include <gtest/gtest.h>

#include <condition_variable>
#include <cstddef>
#include <memory>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "Phone.h"

constexpr size_t kMegabyte = size_t{1024} * 1024;

/// A file whose every stretch is different, so that a wrong join shows.
std::string makeLargeFile(const std::string& name, size_t megabytes);

/// A way to the sharing service that lets so many bytes of its answers through and holds back the
/// rest until it is opened.
class Gate {
 public:
  explicit Gate(size_t bytes);
  ~Gate();
  Gate(const Gate&) = delete;
  Gate& operator=(const Gate&) = delete;

  /// A share of that file, whose size is in whole megabytes, to be had through the gate.
  phone::Share share(const std::string& name, size_t megabytes) const;
  /// Waits until a download holds what was let through.
  testing::AssertionResult isReached() const;
  void open();

 private:
  struct Release {
    void operator()(void* object) const { g_object_unref(object); }
  };

  void _accept();
  void _serve(GSocketConnection* client);
  void _passAnswers(GSocketConnection* from, GSocketConnection* to);
  /// How many of so many bytes may go on now; waits until it is one at least.
  size_t _mayPass(size_t bytes);

  const size_t _bytes;
  std::unique_ptr<GSocketListener, Release> _listener;
  std::unique_ptr<GCancellable, Release> _end;
  guint16 _port = 0;
  std::mutex _mutex;
  std::condition_variable _changed;
  size_t _passed = 0;
  bool _isOpen = false;
  std::vector<std::thread> _connections;  // the accepting thread's, until that has ended
  std::thread _acceptor;
};

void killDownloadApplication();
