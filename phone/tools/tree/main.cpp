// phone-tree: prints what the application on top shows, one line per widget. Waits until two
// readings in a row are the same, five seconds at the most.

#include <base/Bus.h>

#include <chrono>
#include <cstdio>
#include <thread>

#include "AccessibleTree.h"
#include "Screen.h"
#include "ScreenReader.h"
#include "Widget.h"

namespace {

using Clock = std::chrono::steady_clock;

constexpr auto kPatience = std::chrono::seconds(5);
constexpr auto kComingTime = std::chrono::milliseconds(1500);  // of an application that can be read
constexpr auto kBetweenReadings = std::chrono::milliseconds(60);
constexpr auto kBetweenLooks = std::chrono::milliseconds(4);

bool waitFor(AccessibleTree& tree, int pid, Clock::time_point end) {
  while (!tree.find(pid)) {
    if (Clock::now() > end) return false;
    std::this_thread::sleep_for(kBetweenLooks);
  }
  return true;
}

/// What is to be seen now; an empty text when no application shows anything.
std::string look(AccessibleTree& tree) {
  const auto window = topWindow();
  if (!window) return {};
  if (!waitFor(tree, window->pid, Clock::now() + kComingTime)) return describe(*window);
  const auto root = tree.read();
  return root ? describe(*root, *window) : std::string();
}

std::string lookUntilStable(AccessibleTree& tree) {
  const auto end = Clock::now() + kPatience;
  std::string before, now = look(tree);
  do {
    before = now;
    std::this_thread::sleep_for(kBetweenReadings);
    now = look(tree);
  } while (now != before && Clock::now() < end);
  return now;
}

}  // namespace

int main() {
  const common::OwnedBus session = base::sessionBus();
  if (!session) return 1;
  const ScreenReader reader(session.get());
  const common::OwnedBus bus = reader.connect();
  if (!bus) return 1;
  AccessibleTree tree(bus.get());
  fputs(lookUntilStable(tree).c_str(), stdout);
  return 0;
}
