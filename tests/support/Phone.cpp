#include "Phone.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <thread>

namespace fs = std::filesystem;

namespace phone {
namespace {

constexpr const char* kOwnNumber = "+821012345678";
constexpr const char* kFriend = "+821011112222";
/// Without a sandbox, pidof finds other phones' programs and the machine's, too; and what has ended
/// and awaits its parent's question has no environment any more.
constexpr const char* kOurs =
    "ours() { for p in $(pidof \"$@\"); do "
    "grep -qzFx \"PHONE_ID=$PHONE_ID\" /proc/$p/environ && echo $p; done 2>/dev/null; }; ";

Words joined(Words first, const Words& second) {
  first.insert(first.end(), second.begin(), second.end());
  return first;
}

std::string valueAfter(const std::string& text, const std::string& label) {
  const size_t begin = text.find(label);
  if (begin == std::string::npos) return {};
  const size_t value = begin + label.size();
  return text.substr(value, text.find('\n', value) - value);
}

}  // namespace

Phone::Phone(const std::string& name, const Words& upOptions, const Words& environment)
    : _folder(std::string(BUILD_DIR) + "/phones/" + name), _environment(environment) {
  _environment.push_back(std::string("PHONE_BUILD=") + BUILD_DIR);
  while (command({"status"}).status == 0) _folder += "-";  // the same program runs elsewhere, too
  fs::remove_all(_folder);
  const Output output =
      command(joined({"up", "--headless", "--while", std::to_string(getpid())}, upOptions));
  _isUp = output.status == 0;
  EXPECT_EQ(output.status, 0) << output.err;
}

Phone::~Phone() {
  if (_isUp) command({"down"});
}

Output Phone::command(const Words& words) const {
  return run(joined({PHONE_COMMAND, "--state", _folder}, words), _environment);
}

std::string Phone::operator()(const Words& words) const {
  const Output output = command(words);
  EXPECT_EQ(output.status, 0) << "phone " << words[0] << ": " << output.err;
  return output.out;
}

Tree Phone::tree() const {
  return Tree((*this)({"tree"}));
}

std::string Phone::log(const std::string& application) const {
  return (*this)({"log", application});
}

std::vector<std::string> Phone::lines(const std::string& command) const {
  std::vector<std::string> result;
  std::istringstream text((*this)({command}));
  for (std::string line; std::getline(text, line);) result.push_back(line);
  return result;
}

std::string Phone::makeFile(const std::string& name, size_t size) const {
  const fs::path path = fs::path(_folder) / "files" / name;
  fs::create_directories(path.parent_path());
  std::ofstream file(path, std::ios::binary);
  size_t state = std::hash<std::string>()(name);
  for (size_t i = 0; i < size; i++) {
    state = state * 6364136223846793005u + 1442695040888963407u;
    file.put(static_cast<char>(state >> 56));
  }
  return path;
}

Share Phone::share(const Words& files, const Words& options) const {
  return shareTo(kOwnNumber, kFriend, files, options);
}

Share Phone::shareTo(const std::string& recipients, const std::string& sender, const Words& files,
                     const Words& options) const {
  Words words = joined({"share", "--from", sender, "--to", recipients}, options);
  const std::string printed = (*this)(joined(words, files));
  const std::string request = valueAfter(printed, "request: ");
  return {valueAfter(printed, "token: "), request.empty() ? 0 : std::stol(request)};
}

void Phone::launchReceived(const std::string& token) const {
  (*this)({"launch", "received", "--token", token});
}

std::string Phone::processesOf(const Words& programs) const {
  std::string found = command(joined({"shell", "sh", "-c",
                                      std::string(kOurs) + "ours \"$@\" | paste -sd ' '", "sh"},
                                     programs))
                          .out;
  found.erase(found.find_last_not_of('\n') + 1);
  return found;
}

bool Phone::end(const Words& programs, const std::string& signal) const {
  const std::string script =
      std::string(kOurs) + "found=$(ours \"$@\"); [ \"$found\" ] || exit 1; kill -" + signal +
      " $found; "
      "for p in $found; do while [ -e /proc/$p/exe ]; do sleep 0.02; done; done";
  return command(joined({"shell", "sh", "-c", script, "sh"}, programs)).status == 0;
}

void Phone::closeViewer() const {
  end({"zelqo-viewer"});
}

std::string Phone::sanitizerFindings() const {
  std::string findings;
  for (const char* folder : {"run/log", "log"}) {
    std::error_code none;
    for (const auto& entry : fs::directory_iterator(fs::path(_folder) / folder, none)) {
      std::ifstream log(entry.path());
      for (std::string line; std::getline(log, line);) {
        if (line.find("Sanitizer") == std::string::npos &&
            line.find(": runtime error: ") == std::string::npos) {
          continue;
        }
        findings += entry.path().filename().string() + ": " + line + '\n';
      }
    }
  }
  return findings;
}

bool waitFor(const std::function<bool()>& condition, std::chrono::milliseconds patience) {
  const auto end = std::chrono::steady_clock::now() + kSlowness * patience;
  while (!condition()) {
    if (std::chrono::steady_clock::now() > end) return false;
    std::this_thread::sleep_for(std::chrono::milliseconds(30));
  }
  return true;
}

}  // namespace phone
