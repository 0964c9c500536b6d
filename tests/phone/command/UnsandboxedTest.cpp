// A phone on a machine that allows no sandbox.

#include <gtest/gtest.h>

#include <unistd.h>

#include <filesystem>

#include "Phone.h"

namespace fs = std::filesystem;
using phone::Output;
using phone::Phone;

namespace {

constexpr const char* kRoot = "/opt/usr";
const phone::Words kNoSandbox = {"PHONE_SANDBOX=none"};

bool canHaveOne() {
  std::error_code error;
  const auto there = fs::symlink_status(kRoot, error);
  return there.type() == fs::file_type::not_found && access("/opt", W_OK) == 0;
}

}  // namespace

TEST(UnsandboxedPhone, WorksAndGivesTheMachineBackAsItWas) {
  if (!canHaveOne()) GTEST_SKIP() << kRoot << " belongs to this machine";
  {
    const Phone phone("unsandboxed", {}, kNoSandbox);
    ASSERT_TRUE(phone.isUp());
    EXPECT_EQ(fs::read_symlink(kRoot), fs::path(phone.folder()) / "opt-usr");
    EXPECT_NE(phone({"status"}).find("sandbox: no"), std::string::npos);
    EXPECT_EQ(phone({"shell", "xdotool", "getdisplaygeometry"}), "720 1280\n");
    phone({"contact", "add", "Mina", "+821055556666"});
    phone({"network", "cellular"});
    const phone::Share share = phone.share({phone.makeFile("one.txt"), phone.makeFile("two.txt")});
    ASSERT_FALSE(share.token.empty());
    phone.launchReceived(share.token);
    EXPECT_TRUE(phone::waitFor([&] { return phone.tree().items().size() == 2; })) << phone.tree();
  }
  EXPECT_FALSE(fs::exists(fs::symlink_status(kRoot)));
}

TEST(UnsandboxedPhone, IsTheOnlyOne) {
  if (!canHaveOne()) GTEST_SKIP() << kRoot << " belongs to this machine";
  const Phone phone("unsandboxed", {}, kNoSandbox);
  ASSERT_TRUE(phone.isUp());
  const std::string command = SOURCE_DIR "/phone/phone";
  const Output output =
      phone::run({command, "--state", phone.folder() + "-two", "up", "--headless"}, kNoSandbox);
  EXPECT_EQ(output.status, 1);
  EXPECT_NE(output.err.find("one phone at a time"), std::string::npos) << output.err;
}
