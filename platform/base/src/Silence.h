/// Services that let a question go without an answer. They are asked asynchronously whether they
/// are there, and count as silent until they say so or go away.
#pragma once

#include <gio/gio.h>

namespace base {

class Silence {
 public:
  static bool of(GDBusConnection* bus, const char* service);
  static void begin(GDBusConnection* bus, const char* service);
};

}  // namespace base
