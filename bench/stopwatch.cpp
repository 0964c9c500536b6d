// Measures, on the phone's screen and from outside, what a program does. Each command prints one
// line of words and numbers.
//
// stopwatch launch COLOUR SPOTS TOKEN       asks for the page of a received share, and waits until
//                                           that colour (RRGGBB) fills so many spots of the screen
// stopwatch start COLOUR SPOTS PROGRAM...   the same, for a program that is started
// stopwatch ask TOKEN                       only asks for it, and says when
// stopwatch load COLOUR SPOTS TOKEN SECONDS as launch; then asks the window for signs of life
// stopwatch scroll SECONDS                  turns the wheel, to the end if it comes before
// stopwatch page COUNT swipe|KEY            turns so many pages
// stopwatch signal PID COUNT ADDRESS        sends download signals; what they cost that process's
//                                           main thread

#include <app_control.h>
#include <appfw/BusNames.h>
#include <fcntl.h>
#include <gio/gio.h>
#include <spawn.h>
#include <unistd.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <functional>
#include <string>
#include <vector>

#include "Finger.h"
#include "Frames.h"
#include "PhoneScreen.h"

namespace {

constexpr const char* kViewer = "com.orlant.zelqo";
constexpr double kPatienceMs = 60000;
constexpr double kFrameMs = 1000.0 / 60;
/// So long without a change, and the picture has come to rest.
constexpr double kStillMs = 300;
constexpr int kWrongCall = 2;

int fail(const char* why) {
  fprintf(stderr, "stopwatch: %s\n", why);
  return 1;
}

void pauseUntil(double atMs) {
  const double left = atMs - nowMs();
  if (left > 0) usleep(static_cast<useconds_t>(left * 1000));
}

/// A colour on the screen: "first pictures" are there when it fills so many spots.
struct Sight {
  unsigned long colour;
  int spots;

  bool isOn(PhoneScreen& screen) const { return screen.spotsOf(colour) >= spots; }
};

bool waitFor(PhoneScreen& screen, const Sight& sight, bool wanted) {
  const double end = nowMs() + kPatienceMs;
  while (sight.isOn(screen) != wanted) {
    if (!screen.waitForChange(end)) return false;
  }
  return true;
}

bool launch(const char* token) {
  app_control_h request = nullptr;
  app_control_create(&request);
  app_control_set_app_id(request, kViewer);
  app_control_set_operation(request, "http://tizen.org/appcontrol/operation/launch_viewer");
  app_control_add_extra_data(request, "view_type", "received");
  app_control_add_extra_data(request, "contents_token", token);
  const int result = app_control_send_launch_request(request, nullptr, nullptr);
  app_control_destroy(request);
  return result == APP_CONTROL_ERROR_NONE;
}

/// The program stays; it must not hold on to what our caller reads.
bool start(char** words) {
  pid_t pid = 0;
  posix_spawn_file_actions_t files;
  posix_spawn_file_actions_init(&files);
  for (const int file : {STDOUT_FILENO, STDERR_FILENO}) {
    posix_spawn_file_actions_addopen(&files, file, "/dev/null", O_WRONLY, 0);
  }
  const int error = posix_spawnp(&pid, *words, &files, nullptr, words, environ);
  posix_spawn_file_actions_destroy(&files);
  return error == 0;
}

/// Milliseconds from `begin` to the sight, negative when it does not come.
double race(PhoneScreen& screen, const Sight& sight, const std::function<bool()>& begin) {
  if (!waitFor(screen, sight, false)) return -1;
  const double since = nowMs();
  if (!begin() || !waitFor(screen, sight, true)) return -1;
  return nowMs() - since;
}

int printRace(double ms) {
  if (ms < 0) return fail("the pictures did not come");
  printf("ms %.1f\n", ms);
  return 0;
}

/// Prints when, on the clock that all processes share.
int ask(const char* token) {
  GDBusConnection* bus = g_bus_get_sync(G_BUS_TYPE_SESSION, nullptr, nullptr);
  printf("at %.1f\n", nowMs());
  if (!bus || !launch(token)) return fail("the launch failed");
  // The bus forgets what a process asked that has gone before the viewer is there.
  g_variant_unref(g_dbus_connection_call_sync(
      bus, appfw::busName(kViewer).c_str(), "/", "org.freedesktop.DBus.Peer", "Ping", nullptr,
      nullptr, G_DBUS_CALL_FLAGS_NONE, static_cast<int>(kPatienceMs), nullptr, nullptr));
  return 0;
}

int load(PhoneScreen& screen, const Sight& sight, const char* token, double seconds) {
  const double ms = race(screen, sight, [token] { return launch(token); });
  if (ms < 0) return printRace(ms);
  std::vector<double> answers;
  const double end = nowMs() + seconds * 1e3;
  double at = nowMs();
  while (at < end) {
    pauseUntil(at);
    const double answer = screen.askForLife(kPatienceMs);
    if (answer < 0) return fail("the window does not answer");
    answers.push_back(answer);
    at = std::max(at + kFrameMs, nowMs());
  }
  std::sort(answers.begin(), answers.end());
  const auto late = std::count_if(answers.begin(), answers.end(),
                                  [](double answer) { return answer > Frames::kLateMs; });
  printf("ms %.1f asked %zu median %.1f longest %.1f late %zd\n", ms, answers.size(),
         answers[answers.size() / 2], answers.back(), late);
  return 0;
}

void printFrames(const Frames& frames) {
  printf("frames %d fps %.1f longest %.1f late %d", frames.count(), frames.perSecond(),
         frames.longest(), frames.late());
}

int scroll(PhoneScreen& screen, double seconds) {
  constexpr double kTurnMs = 100;  // a steady hand: 1,000 files in five seconds
  Finger finger(screen.display());
  Frames frames;
  finger.moveTo(screen.width() / 2, screen.height() / 2);
  const double end = nowMs() + seconds * 1e3;
  double nextTurn = nowMs();
  double lastChange = nowMs();
  while (nowMs() < end && nowMs() - lastChange < kStillMs) {
    if (nowMs() >= nextTurn) {
      finger.wheelDown();
      nextTurn += kTurnMs;
    }
    if (!screen.waitForChange(nextTurn)) continue;
    lastChange = nowMs();
    frames.add(lastChange);
  }
  printFrames(frames);
  printf(" end %d\n", nowMs() < end);
  return 0;
}

/// Follows the screen until `end`, or until it has been still for a while when that comes first.
void follow(PhoneScreen& screen, double end, bool untilStill,
            const std::function<void(double)>& seen) {
  double last = nowMs();
  while (nowMs() < end) {
    if (screen.waitForChange(untilStill ? std::min(end, last + kStillMs) : end)) {
      last = nowMs();
      seen(last);
    } else if (untilStill) {
      return;
    }
  }
}

/// A finger over two thirds of the screen, then the page's own way to rest.
double swipe(PhoneScreen& screen, Frames* frames) {
  constexpr int kSteps = 12;
  constexpr double kSlideMs = 250;  // the page moves by itself after the finger has gone
  Finger finger(screen.display());
  const int y = screen.height() / 2;
  const auto x = [&screen](int step) {
    return screen.width() * 5 / 6 - screen.width() * 2 / 3 * step / kSteps;
  };
  finger.moveTo(x(0), y);
  finger.press();
  const double begin = nowMs();
  double last = begin;
  frames->pause();
  const auto seen = [&](double at) {
    last = at;
    frames->add(at);
  };
  for (int step = 1; step <= kSteps; ++step) {
    finger.moveTo(x(step), y);
    follow(screen, begin + step * kFrameMs, false, seen);
  }
  finger.lift();
  follow(screen, nowMs() + kSlideMs, false, seen);
  follow(screen, nowMs() + kPatienceMs, true, [&last](double at) { last = at; });
  return last - begin;
}

double press(PhoneScreen& screen, const char* key) {
  Finger(screen.display()).key(key);
  const double begin = nowMs();
  if (!screen.waitForChange(begin + kPatienceMs)) return kPatienceMs;
  double last = nowMs();
  follow(screen, begin + kPatienceMs, true, [&last](double at) { last = at; });
  return last - begin;
}

int page(PhoneScreen& screen, int count, const char* how) {
  Frames frames;
  std::vector<double> times;
  times.reserve(static_cast<size_t>(std::max(count, 0)));
  for (int i = 0; i < count; ++i) {
    times.push_back(strcmp(how, "swipe") == 0 ? swipe(screen, &frames) : press(screen, how));
  }
  std::sort(times.begin(), times.end());
  printFrames(frames);
  printf(" median %.1f slowest %.1f\n", times[times.size() / 2], times.back());
  return 0;
}

/// Processor microseconds of the main thread.
double mainThreadUs(const char* pid) {
  const std::string path = std::string("/proc/") + pid + "/task/" + pid + "/schedstat";
  char* text = nullptr;
  if (!g_file_get_contents(path.c_str(), &text, nullptr, nullptr)) return -1;
  const double us = g_ascii_strtod(text, nullptr) / 1e3;
  g_free(text);
  return us;
}

int signal(const char* pid, int count, const char* address) {
  constexpr double kPauseMs = 4;
  GDBusConnection* bus = g_bus_get_sync(G_BUS_TYPE_SYSTEM, nullptr, nullptr);
  const double duration = count * kPauseMs + 500;
  const double idleBegin = mainThreadUs(pid);
  if (!bus || idleBegin < 0) return fail("no bus or no such process");
  pauseUntil(nowMs() + duration);
  const double before = mainThreadUs(pid);
  const double begin = nowMs();
  for (int i = 0; i < count; ++i) {
    g_dbus_connection_emit_signal(
        bus, nullptr, "/com/orlant/remoteshare", "org.tizen.call.remote.share",
        i % 2 ? "file_downloaded" : "file_downloading", g_variant_new("(s)", address), nullptr);
    pauseUntil(begin + (i + 1) * kPauseMs);
  }
  pauseUntil(begin + duration);
  const double idle = before - idleBegin;
  printf("us %.1f idle %.1f\n", (mainThreadUs(pid) - before - idle) / count, idle / count);
  return 0;
}

/// Other work on the machine shall disturb little what is started from here. Where that is not
/// allowed, nothing changes.
void takePrecedence() {
  const int file = open("/proc/self/autogroup", O_WRONLY | O_CLOEXEC);
  if (file < 0) return;
  if (write(file, "-15", 3) != 3) fprintf(stderr, "stopwatch: no precedence\n");
  close(file);
}

int run(int argc, char** argv) {
  takePrecedence();
  PhoneScreen screen;
  if (!screen.isOpen()) return fail("no display");
  const std::string what = argc > 1 ? argv[1] : "";
  const Sight sight{argc > 3 ? strtoul(argv[2], nullptr, 16) : 0, argc > 3 ? atoi(argv[3]) : 0};
  if (what == "launch" && argc == 5) {
    return printRace(race(screen, sight, [&] { return launch(argv[4]); }));
  }
  if (what == "start" && argc > 4) {
    return printRace(race(screen, sight, [&] { return start(argv + 4); }));
  }
  if (what == "ask" && argc == 3) return ask(argv[2]);
  if (what == "load" && argc == 6) return load(screen, sight, argv[4], atof(argv[5]));
  if (what == "scroll" && argc == 3) return scroll(screen, atof(argv[2]));
  if (what == "page" && argc == 4) return page(screen, atoi(argv[2]), argv[3]);
  if (what == "signal" && argc == 5) return signal(argv[2], atoi(argv[3]), argv[4]);
  fprintf(
      stderr,
      "stopwatch launch COLOUR SPOTS TOKEN | start COLOUR SPOTS PROGRAM... | ask TOKEN | load "
      "COLOUR "
      "SPOTS TOKEN SECONDS | scroll SECONDS | page COUNT swipe|KEY | signal PID COUNT ADDRESS\n");
  return kWrongCall;
}

}  // namespace

int main(int argc, char** argv) {
  return run(argc, argv);
}
