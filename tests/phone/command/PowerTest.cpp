// Starting and ending a phone.

#include <gtest/gtest.h>
#include <signal.h>
#include <unistd.h>

#include <algorithm>
#include <cctype>
#include <filesystem>
#include <fstream>
#include <regex>
#include <sstream>

#include "Phone.h"

namespace fs = std::filesystem;
using phone::Output;
using phone::Phone;
using phone::thePhone;
using phone::Words;

namespace {

bool sandboxed() {
  return thePhone()({"status"}).find("sandbox: yes") != std::string::npos;
}

/// Processes of this machine whose command line or environment names the folder.
std::vector<int> processesOf(const std::string& folder) {
  std::vector<int> found;
  for (const auto& entry : fs::directory_iterator("/proc")) {
    const std::string name = entry.path().filename();
    if (!isdigit(static_cast<unsigned char>(name[0])) || std::stoi(name) == getpid()) continue;
    for (const char* file : {"cmdline", "environ"}) {
      std::ifstream source(entry.path() / file, std::ios::binary);
      std::ostringstream text;
      text << source.rdbuf();  // which reads nothing of a process that has just ended
      if (text.str().find(folder) == std::string::npos) continue;
      found.push_back(std::stoi(name));
      break;
    }
  }
  return found;
}

}  // namespace

TEST(PhoneUp, LeavesAPhoneWhoseServicesAnswer) {
  Phone& phone = thePhone();
  ASSERT_TRUE(phone.isUp());
  const std::string names =
      phone({"shell", "gdbus", "call", "--session", "--dest", "org.freedesktop.DBus",
             "--object-path", "/", "--method", "org.freedesktop.DBus.ListNames"});
  EXPECT_NE(names.find("org.freedesktop.Notifications"), std::string::npos);
  EXPECT_NE(names.find("org.gnome.evolution.dataserver.AddressBook10"), std::string::npos);
  EXPECT_EQ(phone({"shell", "xdotool", "getdisplaygeometry"}), "720 1280\n");
  EXPECT_EQ(phone({"shell", "sh", "-c", "ls -d /opt/usr/apps"}), "/opt/usr/apps\n");
}

TEST(PhoneUp, RefusesASecondPhoneInTheSameFolder) {
  const Output output = thePhone().command({"up", "--headless"});
  EXPECT_EQ(output.status, 1);
  EXPECT_NE(output.err.find("already up"), std::string::npos) << output.err;
}

TEST(PhoneUp, RunsTwoPhonesSideBySide) {
  if (!sandboxed()) GTEST_SKIP() << "without a sandbox there is one phone at a time";
  const Phone other("beside", {"--number", "+821099998888", "--screen", "480x800"});
  ASSERT_TRUE(other.isUp());
  EXPECT_EQ(other({"shell", "xdotool", "getdisplaygeometry"}), "480 800\n");
  EXPECT_EQ(thePhone()({"shell", "xdotool", "getdisplaygeometry"}), "720 1280\n");
  other({"shell", "touch", "/opt/usr/media/only-here"});
  EXPECT_NE(thePhone().command({"shell", "ls", "/opt/usr/media/only-here"}).status, 0);
}

TEST(PhoneDown, LeavesNothingBehindAndKeepsWhatWasStored) {
  if (!sandboxed()) GTEST_SKIP() << "without a sandbox there is one phone at a time";
  Phone phone("again");
  ASSERT_TRUE(phone.isUp());
  phone({"prefs", "set", "a key", "a value"});
  phone({"contact", "add", "Mina", "+821055556666"});
  phone({"language", "de_DE"});
  ASSERT_FALSE(processesOf(phone.folder()).empty());
  phone({"down"});
  EXPECT_TRUE(phone::waitFor([&] { return processesOf(phone.folder()).empty(); }));
  EXPECT_EQ(phone.command({"status"}).status, 3);
  phone({"up", "--headless"});
  EXPECT_EQ(phone({"prefs", "get", "a key"}), "a value\n");
  EXPECT_EQ(phone({"contact", "list"}), "Mina\t+821055556666\n");
  EXPECT_EQ(phone({"shell", "sh", "-c", "echo $LANG"}), "de_DE.UTF-8\n");
}

/// The phone's processes that were started by this command, as the machine sees them.
std::vector<int> processesOf(const std::string& folder, const std::string& command) {
  std::vector<int> found;
  for (const int pid : processesOf(folder)) {
    std::ifstream source("/proc/" + std::to_string(pid) + "/cmdline", std::ios::binary);
    std::ostringstream text;
    text << source.rdbuf();
    std::string line = text.str();
    std::replace(line.begin(), line.end(), '\0', ' ');
    if (std::regex_search(line, std::regex(command))) found.push_back(pid);
  }
  return found;
}

TEST(PhoneDown, HappensAlsoWhenAnyOfItsProcessesIsKilled) {
  if (!sandboxed()) GTEST_SKIP() << "without a sandbox there is one phone at a time";
  const char* const kKeeper = "^[^ ]*python3 .*phone .* up ";
  for (const char* victim : {kKeeper, "^bwrap ", "^[^ ]*python3 .*/supervisor", "^Xvfb "}) {
    SCOPED_TRACE(victim);
    Phone phone("killed");
    ASSERT_TRUE(phone.isUp());
    const auto victims = processesOf(phone.folder(), victim);
    ASSERT_FALSE(victims.empty());
    kill(victims.front(), SIGKILL);
    EXPECT_TRUE(phone::waitFor([&] { return processesOf(phone.folder()).empty(); }));
    EXPECT_EQ(phone.command({"up", "--headless"}).status, 0);
  }
}

TEST(PhoneDown, HappensWhenTheProcessThatThePhoneIsForHasGone) {
  if (!sandboxed()) GTEST_SKIP() << "without a sandbox there is one phone at a time";
  Phone phone("for-another");
  phone({"down"});
  const std::string command = SOURCE_DIR "/phone/phone --state " + phone.folder();
  const Output output = phone::run({"sh", "-c",
                                    "exec 2>&1; " + command + " up --headless --while $$ && " +
                                        command + " status >/dev/null && echo was up"});
  EXPECT_EQ(output.out, "was up\n");
  EXPECT_TRUE(phone::waitFor([&] { return processesOf(phone.folder()).empty(); }));
}

struct WrongCall {
  Words words;
  const char* says;
};

TEST(PhoneCommand, SaysInOneLineWhatIsWrongWithItsArguments) {
  const WrongCall calls[] = {
      {{"up", "--screen", "big"}, "720x1280"},
      {{"up", "--screen"}, "--screen"},
      {{"up", "--lang", "../x"}, "locale"},
      {{"up", "--number", "me"}, "number"},
      {{"up", "now"}, "now"},
      {{"fly"}, "fly"},
      {{"share", "--from", "+1"}, "--to"},
      {{"share", "--from", "+1", "--to", "+2"}, "file"},
      {{"launch"}, "received"},
      {{"launch", "received"}, "--token"},
      {{"launch", "sent", "--request", "x"}, "whole number"},
      {{"launch", "raw", "main", "no-equals"}, "KEY=VALUE"},
      {{"tap"}, "NAME"},
      {{"tap", "9999,1"}, "not on the screen"},
      {{"swipe", "1,1"}, "X,Y"},
      {{"swipe", "here", "there"}, "place"},
      {{"key", "rm -rf"}, "key"},
      {{"rotate", "45"}, "45"},
      {{"network", "pigeon"}, "pigeon"},
      {{"account", "maybe"}, "maybe"},
      {{"clock", "13"}, "13"},
      {{"theme", "pink"}, "pink"},
      {{"textsize", "500"}, "size of texts"},
      {{"service", "slow"}, "milliseconds"},
      {{"service", "sideways"}, "sideways"},
      {{"contact", "add", "Nobody"}, "contact"},
      {{"prefs", "set", "a"}, "prefs"},
      {{"signal", "one"}, "MEMBER"},
      {{"screenshot"}, "FILE"},
      {{"log", "../../phone"}, "id"},
  };
  for (const auto& call : calls) {
    const Output output = thePhone().command(call.words);
    SCOPED_TRACE(testing::PrintToString(call.words) + ": " + output.err);
    EXPECT_EQ(output.status, 2);
    EXPECT_EQ(std::count(output.err.begin(), output.err.end(), '\n'), 1);
    EXPECT_NE(output.err.find(call.says), std::string::npos);
    EXPECT_EQ(output.out, "");
  }
}

TEST(PhoneCommand, SaysThatThePhoneIsDown) {
  const std::string folder = thePhone().folder() + "-that-never-was";
  for (const Words& words :
       {Words{"tree"}, {"tap", "1,1"}, {"network", "wifi"}, {"shell", "true"}}) {
    Words elsewhere = {"--state", folder};
    elsewhere.insert(elsewhere.end(), words.begin(), words.end());
    const Output output = thePhone().command(elsewhere);
    EXPECT_NE(output.status, 0);
    EXPECT_EQ(std::count(output.err.begin(), output.err.end(), '\n'), 1) << output.err;
  }
}

TEST(PhoneShell, PassesOnInputOutputAndStatus) {
  Phone& phone = thePhone();
  const Output output = phone.command({"shell", "sh", "-c", "echo out; echo err >&2; exit 7"});
  EXPECT_EQ(output.status, 7);
  EXPECT_EQ(output.out, "out\n");
  EXPECT_EQ(output.err, "err\n");
  EXPECT_EQ(phone.command({"shell", "sh", "-c", "kill -9 $$"}).status, 128 + SIGKILL);
  EXPECT_NE(phone.command({"shell", "no-such-program"}).status, 0);
}

TEST(PhoneShell, EndsWhatItStartedWhenItsCallerGoes) {
  Phone& phone = thePhone();
  phone::run({"timeout", "--signal=KILL", "1", "sh", "-c", "exec \"$@\"", "sh",
              std::string(SOURCE_DIR) + "/phone/phone", "--state", phone.folder(), "shell", "sleep",
              "4242"});
  EXPECT_TRUE(phone::waitFor([&] {
    return phone.command({"shell", "pgrep", "-f", "^sleep 4242"}).status != 0;
  }));
}
