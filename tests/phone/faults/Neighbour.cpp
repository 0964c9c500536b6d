#include "Neighbour.h"

#include <gtest/gtest.h>

#include <ostream>

#include "Phone.h"

using phone::thePhone;

namespace {

std::string inPhone(const std::string& script) {
  return thePhone().command({"shell", "sh", "-c", script}).out;
}

/// Starts a program of the build that stays.
std::string begun(const std::string& program) {
  return "setsid " + program + " </dev/null >/dev/null 2>&1 &";
}

std::string processesOf(const Neighbour& neighbour) {
  if (neighbour.status.empty()) return thePhone().processesOf(neighbour.programs);
  const std::string status = thePhone()({"status"});
  const std::string label = "  " + neighbour.status + ": runs, process ";
  const size_t begin = status.find(label);
  if (begin == std::string::npos) return {};
  const size_t number = begin + label.size();
  return status.substr(number, status.find('\n', number) - number);
}

}  // namespace

namespace neighbour {

const Neighbour kService{"Service", "service", {}, ""};
const Neighbour kAgent{"Agent", "", {"zelqo-agent"}, begun(PROGRAMS "/zelqo-agent")};
/// The bus starts them when they are asked for.
const Neighbour kContacts{
    "Contacts", "", {"evolution-addressbook-factory", "evolution-source-registry"}, ""};
const Neighbour kSessionBus{"SessionBus", "session-bus", {}, ""};
const Neighbour kSystemBus{"SystemBus", "system-bus", {}, ""};
const Neighbour kNotifications{
    "Notifications", "", {"dunst"}, begun("dunst -conf $XDG_RUNTIME_DIR/dunstrc")};
const Neighbour kDownloadManager{"Downloads", "", {"download-manager"}, ""};
const Neighbour kSignUpPage{"SignUp", "", {"ovuport"}, ""};
const Neighbour kWorld{"World", "", {"phone-world"}, begun(PROGRAMS "/phone-world")};

}  // namespace neighbour

std::ostream& operator<<(std::ostream& out, const Neighbour& neighbour) {
  return out << neighbour.name;
}

Harmed::Harmed(const Neighbour& neighbour, Harm harm)
    : _neighbour(neighbour), _harm(harm), _processes(processesOf(neighbour)) {
  EXPECT_NE(_processes.find_first_of("0123456789"), std::string::npos)
      << neighbour.name << " does not run";
  inPhone((harm == Harm::Kill ? "kill -KILL " : "kill -STOP ") + _processes);
}

Harmed::~Harmed() {
  if (_harm == Harm::Freeze) {
    inPhone("kill -CONT " + _processes);
  } else if (&_neighbour == &neighbour::kService) {
    thePhone()({"service", "ok"});
  } else if (!_neighbour.revival.empty()) {
    thePhone().end(_neighbour.programs);  // the bus may have started one of its own
    inPhone(_neighbour.revival);
  }
}
