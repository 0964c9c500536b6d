// loop_watch PROGRAM: how long a program's main loop does not answer.
//
// The program's window is asked again and again whether it is alive, as a window manager does. Runs
// on the phone until its standard input ends; each line of it is answered by one line:
//   begin      "begun": what was measured before is forgotten
//   settle MS  "answers" when the program has answered a question asked after this one, "gone" when
//              there is no such program, "silent" when neither came true in time
//   rest MS    as settle, and then waits until the screen stands still
//   do COMMAND runs it in the phone's shell; "done"
//   report     "longest MS idle MS": the longest time without an answer, from the first moment of
//              the process on; "idle" is the longest such time without those moments in which a
//              thread of the process ran or waited for a processor, or the screen was slow: time
//              that the program waited for somebody else, whatever else the machine had to do

#include <X11/Xatom.h>
#include <X11/Xlib.h>
#include <X11/Xutil.h>
#include <fcntl.h>
#include <poll.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>
#include <string>
#include <string_view>
#include <utility>

namespace fs = std::filesystem;

namespace {

using Clock = std::chrono::steady_clock;
using Ms = std::chrono::duration<double, std::milli>;

constexpr int kPauseMs = 15;
/// A screen that never stands still shows an animation, which may go on.
constexpr double kLongestMoveMs = 1500;
constexpr int kSamePictures = 4;

/// Without a sandbox other phones' programs are to be seen, too.
bool isOfThisPhone(const fs::path& process) {
  const char* id = getenv("PHONE_ID");
  const std::string wanted = std::string("PHONE_ID=") + (id ? id : "");
  std::ifstream environment(process / "environ", std::ios::binary);
  for (std::string entry; std::getline(environment, entry, '\0');) {
    if (entry == wanted) return true;
  }
  return false;
}

/// 0 when there is none.
int processCalled(const std::string& program) {
  std::error_code none;
  for (const auto& entry : fs::directory_iterator("/proc", none)) {
    const std::string name = entry.path().filename();
    if (name.find_first_not_of("0123456789") != std::string::npos) continue;
    std::string command;
    std::getline(std::ifstream(entry.path() / "comm"), command);
    if (command == program.substr(0, 15) && isOfThisPhone(entry.path())) return std::stoi(name);
  }
  return 0;
}

/// Milliseconds that the threads ran or stood in line for a processor, since each was last seen.
class Busy {
 public:
  double since(int process) {
    double sum = 0;
    std::error_code none;
    for (const auto& task :
         fs::directory_iterator("/proc/" + std::to_string(process) + "/task", none)) {
      double ran = 0, stood = 0;
      std::ifstream(task.path() / "schedstat") >> ran >> stood;
      double& before = _seen[task.path()];
      sum += (ran + stood - before) / 1e6;
      before = ran + stood;
    }
    return sum;
  }

 private:
  std::map<std::string, double> _seen;
};

class Questioner {
 public:
  Questioner() : _display(XOpenDisplay(nullptr)) {
    if (!_display) return;
    XSetErrorHandler([](Display*, XErrorEvent*) { return 0; });  // windows go while they are asked
    _root = DefaultRootWindow(_display);
    _protocols = XInternAtom(_display, "WM_PROTOCOLS", False);
    _ping = XInternAtom(_display, "_NET_WM_PING", False);
    _pid = XInternAtom(_display, "_NET_WM_PID", False);
    _clients = XInternAtom(_display, "_NET_CLIENT_LIST", False);
    XSelectInput(_display, _root, SubstructureNotifyMask);
  }
  ~Questioner() {
    if (_display) XCloseDisplay(_display);
  }
  Questioner(const Questioner&) = delete;
  Questioner& operator=(const Questioner&) = delete;

  bool isOpen() const { return _display != nullptr; }

  Window windowOf(int process) {
    unsigned long count = 0;
    auto* clients = static_cast<unsigned long*>(property(_root, _clients, XA_WINDOW, &count));
    Window found = 0;
    for (unsigned long i = 0; i < count && !found; i++) {
      unsigned long any = 0;
      auto* pid = static_cast<unsigned long*>(property(clients[i], _pid, XA_CARDINAL, &any));
      if (pid && static_cast<int>(*pid) == process) found = clients[i];
      if (pid) XFree(pid);
    }
    if (clients) XFree(clients);
    return found;
  }

  void ask(Window window, long number) {
    XEvent event{};
    event.xclient.type = ClientMessage;
    event.xclient.window = window;
    event.xclient.message_type = _protocols;
    event.xclient.format = 32;
    event.xclient.data.l[0] = static_cast<long>(_ping);
    event.xclient.data.l[1] = number;
    event.xclient.data.l[2] = static_cast<long>(window);
    XSendEvent(_display, window, False, NoEventMask, &event);
    XFlush(_display);
  }

  /// The number of the last question that was answered, 0 when none was.
  long answered() {
    long number = 0;
    while (XPending(_display)) {
      XEvent event;
      XNextEvent(_display, &event);
      if (event.type == ClientMessage && event.xclient.message_type == _protocols &&
          static_cast<Atom>(event.xclient.data.l[0]) == _ping) {
        number = std::max(number, event.xclient.data.l[1]);
      }
    }
    return number;
  }

  void wait() { XSync(_display, False); }

  /// A number for what the screen shows.
  size_t picture() {
    const int screen = DefaultScreen(_display);
    XImage* image =
        XGetImage(_display, _root, 0, 0, static_cast<unsigned>(DisplayWidth(_display, screen)),
                  static_cast<unsigned>(DisplayHeight(_display, screen)), AllPlanes, ZPixmap);
    if (!image) return 0;
    const std::string_view bytes(image->data, static_cast<size_t>(image->bytes_per_line) *
                                                  static_cast<size_t>(image->height));
    const size_t number = std::hash<std::string_view>()(bytes);
    XDestroyImage(image);
    return number;
  }

 private:
  void* property(Window window, Atom name, Atom type, unsigned long* count) {
    Atom actual = 0;
    int format = 0;
    unsigned long rest = 0;
    unsigned char* data = nullptr;
    XGetWindowProperty(_display, window, name, 0, 1024, False, type, &actual, &format, count, &rest,
                       &data);
    return data;
  }

  Display* const _display;
  Window _root = 0;
  Atom _protocols = 0, _ping = 0, _pid = 0, _clients = 0;
};

class Watch {
 public:
  explicit Watch(std::string program) : _program(std::move(program)) {}

  void look(Questioner& screen) {
    const auto now = Clock::now();
    const double passed = Ms(now - _looked).count();
    _looked = now;
    screen.wait();
    const double screenTook = Ms(Clock::now() - now).count();
    const int process = processCalled(_program);
    if (process != _process) begin(process);
    _absent = process ? 0 : _absent + passed;
    if (!process) return;
    const double busy = _busy.since(process);
    _gap += passed;
    _idle += std::max(0.0, passed - busy - _screenTook);
    _screenTook = screenTook;
    if (screen.answered() == _asked && _waiting) end();
    remember();
    if (!_window) _window = screen.windowOf(process);
    if (_window && !_waiting) {
      screen.ask(_window, ++_asked);
      _waiting = true;
    }
  }

  void forget() { _longest = _longestIdle = 0; }
  void report() const {
    printf("longest %.0f idle %.0f\n", _longest, _longestIdle);
    fflush(stdout);
  }
  long asked() const { return _asked; }
  long answered() const { return _answered; }
  bool isGone() const { return _absent > kGoneMs; }

 private:
  /// A program that is being started is not there for a moment.
  static constexpr double kGoneMs = 300;

  void begin(int process) {
    _process = process;
    _window = 0;
    _waiting = false;
    _busy = Busy();
    _busy.since(process);
    _gap = _idle = 0;
  }
  void end() {
    _answered = _asked;
    _waiting = false;
    remember();
    _gap = _idle = 0;
  }
  void remember() {
    _longest = std::max(_longest, _gap);
    _longestIdle = std::max(_longestIdle, _idle);
  }

  const std::string _program;
  Clock::time_point _looked = Clock::now();
  int _process = 0;
  Window _window = 0;
  bool _waiting = false;
  long _asked = 0, _answered = 0;
  Busy _busy;
  double _gap = 0, _idle = 0, _longest = 0, _longestIdle = 0, _screenTook = 0, _absent = 0;
};

/// The lines of the standard input.
class Orders {
 public:
  Orders(Questioner& screen, Watch& watch) : _screen(screen), _watch(watch) {}

  void follow() {
    pollfd input{STDIN_FILENO, POLLIN, 0};
    for (;;) {
      while (poll(&input, 1, kPauseMs) == 0) _watch.look(_screen);
      char more[256];
      const ssize_t size = read(STDIN_FILENO, more, sizeof more);
      if (size <= 0) return;
      _text.append(more, static_cast<size_t>(size));
      for (size_t end; (end = _text.find('\n')) != std::string::npos; _text.erase(0, end + 1)) {
        obey(_text.substr(0, end));
      }
    }
  }

 private:
  void obey(const std::string& line) {
    std::istringstream words(line);
    std::string order;
    double patience = 0;
    words >> order >> patience;
    if (order == "settle") say(settle(patience));
    if (order == "rest") say(rest(patience));
    if (order == "do") {
      run(line.substr(3));
      say("done");
    }
    if (order == "report") _watch.report();
    if (order == "begin") {
      _watch.forget();
      say("begun");
    }
  }

  const char* settle(double patience) {
    const long before = _watch.asked();
    const auto end = Clock::now() + Ms(patience);
    while (Clock::now() < end) {
      _watch.look(_screen);
      if (_watch.answered() > before) return "answers";
      if (_watch.isGone()) return "gone";
      usleep(kPauseMs * 1000);
    }
    return "silent";
  }

  /// Pages on their way in take no input.
  const char* rest(double patience) {
    const char* answer = settle(patience);
    const auto end = Clock::now() + Ms(kLongestMoveMs);
    size_t before = _screen.picture();
    for (int same = 0; same < kSamePictures && Clock::now() < end; usleep(kPauseMs * 1000)) {
      _watch.look(_screen);
      const size_t now = _screen.picture();
      same = now == std::exchange(before, now) ? same + 1 : 0;
    }
    return answer;
  }

  void run(const std::string& command) {
    const pid_t child = fork();
    if (child == 0) {
      const int nothing = open("/dev/null", O_RDWR);
      for (int file : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO}) dup2(nothing, file);
      execl("/bin/sh", "sh", "-c", command.c_str(), nullptr);
      _exit(127);
    }
    while (child > 0 && waitpid(child, nullptr, WNOHANG) == 0) {
      _watch.look(_screen);
      usleep(kPauseMs * 1000);
    }
  }

  static void say(const char* answer) {
    puts(answer);
    fflush(stdout);
  }

  Questioner& _screen;
  Watch& _watch;
  std::string _text;
};

}  // namespace

int main(int argc, char** argv) {
  if (argc != 2) return 2;
  Questioner screen;
  if (!screen.isOpen()) return 1;
  Watch watch(argv[1]);
  Orders(screen, watch).follow();
  return 0;
}
