/// A simulated phone: up as long as the object lives. Its commands are those of `phone`.
#pragma once

#include <chrono>
#include <functional>
#include <string>
#include <vector>

#include "Process.h"
#include "Tree.h"

namespace phone {

struct Share {
  std::string token;
  long request = 0;
};

class Phone {
 public:
  /// `name` is that of its state folder, below the build folder; the folder is emptied first.
  /// `upOptions` are those of `phone up` in addition to --headless.
  explicit Phone(const std::string& name, const Words& upOptions = {},
                 const Words& environment = {});
  ~Phone();
  Phone(const Phone&) = delete;
  Phone& operator=(const Phone&) = delete;

  bool isUp() const { return _isUp; }
  const std::string& folder() const { return _folder; }

  /// Any command; the caller judges its status.
  Output command(const Words& words) const;
  /// A command that has to work, else the test fails; what it printed.
  std::string operator()(const Words& words) const;

  Tree tree() const;
  /// What the viewer, or another application, has logged since the phone is up.
  std::string log(const std::string& application = "com.orlant.zelqo") const;
  /// Lines of the JSON kind: launches, usage, signals.
  std::vector<std::string> lines(const std::string& command) const;

  /// A file of that name and size for sharing, different for every name.
  std::string makeFile(const std::string& name, size_t size = 1000) const;
  Share share(const Words& files, const Words& options = {}) const;
  Share shareTo(const std::string& recipients, const std::string& sender, const Words& files,
                const Words& options = {}) const;
  void launchReceived(const std::string& token) const;

  /// The processes of programs of this phone, parted by blanks; of no other phone's and not the
  /// machine's, which share their names where there is no sandbox. Empty when there is none.
  std::string processesOf(const Words& programs) const;
  /// Ends them and returns when they have gone. False when there was none.
  bool end(const Words& programs, const std::string& signal = "TERM") const;
  /// Ends the viewer, so that the next test finds the phone as after its start.
  void closeViewer() const;

  /// What stands in the logs of a program that the sanitizers stopped; empty when all is well.
  std::string sanitizerFindings() const;

 private:
  std::string _folder;
  Words _environment;
  bool _isUp = false;
};

#ifdef __SANITIZE_ADDRESS__
constexpr int kSlowness = 4;  ///< of programs under the sanitizers
#else
constexpr int kSlowness = 1;
#endif
constexpr std::chrono::seconds kPatience{20};

/// Looks again and again until the condition holds. False when it does not in that time, or in
/// `kSlowness` times as much.
bool waitFor(const std::function<bool()>& condition,
             std::chrono::milliseconds patience = kPatience);

/// The phone of this test program; started by the first call.
Phone& thePhone();
/// Another one in its place, started with these options of `phone up`.
Phone& thePhoneWith(const Words& upOptions);

}  // namespace phone
