// Writes down every signal that is seen on the system bus, one JSON object per line.
#pragma once

#include <base/Bus.h>

#include <cstdio>

class Recorder {
 public:
  /// Appends to the file; check isOpen().
  explicit Recorder(const char* file);

  bool isOpen() const { return _file != nullptr; }

 private:
  static void _signalCb(GDBusConnection*, const char* sender, const char* path,
                        const char* interface, const char* member, GVariant* body, gpointer self);

  common::Owned<FILE, fclose> _file;
  base::SignalSubscription _signals;
};
