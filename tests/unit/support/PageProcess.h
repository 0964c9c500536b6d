#pragma once

#include <gio/gio.h>

/// What a process needs that tests pages in a window of its own: a system bus that nobody else is
/// on, and the settings of a phone.
class PageProcess {
 public:
  explicit PageProcess(const char* theme);
  PageProcess(const PageProcess&) = delete;
  PageProcess& operator=(const PageProcess&) = delete;

  /// Ends the process without the clean-up of GIO, which would wait for connections that live as
  /// long as the process.
  [[noreturn]] void end(int result);

 private:
  GTestDBus* _bus;
};
