/// A program around the viewer that can be killed, or stopped in the middle of whatever it does.
#pragma once

#include <functional>
#include <iosfwd>
#include <string>

#include "Phone.h"

struct Neighbour {
  std::string name;
  /// As the phone's status calls it; empty for what `programs` are.
  std::string status;
  phone::Words programs;
  /// Brings it back after it was killed; empty when that happens by itself.
  std::string revival;
};

std::ostream& operator<<(std::ostream& out, const Neighbour& neighbour);

enum class Harm { Kill, Freeze };

/// Harms a neighbour until this object goes; then it is there again.
class Harmed {
 public:
  Harmed(const Neighbour& neighbour, Harm harm);
  ~Harmed();
  Harmed(const Harmed&) = delete;
  Harmed& operator=(const Harmed&) = delete;

 private:
  const Neighbour& _neighbour;
  const Harm _harm;
  std::string _processes;
};

namespace neighbour {
extern const Neighbour kService, kAgent, kContacts, kSessionBus, kSystemBus, kNotifications,
    kDownloadManager, kSignUpPage, kWorld;
}  // namespace neighbour
