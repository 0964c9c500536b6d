#pragma once

#include <base/Bus.h>

#include <string>
#include <vector>

/// Takes the place of the desktop's thumbnailer on the test's bus and remembers what it is asked.
class FakeThumbnailer {
 public:
  FakeThumbnailer();
  ~FakeThumbnailer();
  FakeThumbnailer(const FakeThumbnailer&) = delete;
  FakeThumbnailer& operator=(const FakeThumbnailer&) = delete;

  int calls() const { return _calls; }
  const std::vector<std::string>& uris() const { return _uris; }
  const std::vector<std::string>& types() const { return _types; }

 private:
  static void _callCb(GDBusConnection* bus, const char* sender, const char* path,
                      const char* interface, const char* method, GVariant* arguments,
                      GDBusMethodInvocation* invocation, void* data);

  common::OwnedBus _bus;
  int _calls = 0;
  std::vector<std::string> _uris;
  std::vector<std::string> _types;
};
