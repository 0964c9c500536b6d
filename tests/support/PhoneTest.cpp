// The main program of phone tests: one phone for all tests of the program, a picture of the screen
// for each test that fails.

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <memory>

#include "Phone.h"

namespace phone {
namespace {

std::unique_ptr<Phone>& current() {
  static std::unique_ptr<Phone> phone;
  return phone;
}

std::string end(const std::string& text) {
  constexpr size_t kBytes = 2000;
  if (text.size() <= kBytes) return text;
  return text.substr(text.find('\n', text.size() - kBytes) + 1);
}

void putAway() {
  if (!current()) return;
  current()->command({"down"});
  EXPECT_EQ(current()->sanitizerFindings(), "");
  current().reset();
}

class PutAway : public testing::Environment {
 public:
  void TearDown() override { putAway(); }
};

/// What the screen shows at a test's first failure, before its fixture puts the phone in order.
class Pictures : public testing::EmptyTestEventListener {
  void OnTestStart(const testing::TestInfo& test) override {
    _picture.clear();
    _name = std::string(test.test_suite_name()) + "." + test.name();
    std::replace(_name.begin(), _name.end(), '/', '-');
  }

  // googletest holds its lock here: nothing below may ask it for anything.
  void OnTestPartResult(const testing::TestPartResult& part) override {
    if (!part.failed() || !_picture.empty() || !current() || !current()->isUp()) return;
    const std::string folder = std::string(BUILD_DIR) + "/test-results";
    std::filesystem::create_directories(folder);
    _picture = folder + "/" + _name + ".png";
    if (current()->command({"screenshot", _picture}).status != 0) _picture = "(none)";
  }

  void OnTestEnd(const testing::TestInfo& test) override {
    if (!test.result()->Failed() || !current() || !current()->isUp()) return;
    printf("the screen: %s\nthe end of the viewer's log:\n%s\n", _picture.c_str(),
           end(current()->command({"log"}).out).c_str());
  }

  std::string _name, _picture;
};

}  // namespace

Phone& thePhone() {
  return current() ? *current() : thePhoneWith({});
}

Phone& thePhoneWith(const Words& upOptions) {
  putAway();
  const auto program = std::filesystem::read_symlink("/proc/self/exe");
  current() = std::make_unique<Phone>(program.filename().string(), upOptions);
  return *current();
}

}  // namespace phone

int main(int argc, char** argv) {
  testing::InitGoogleTest(&argc, argv);
  testing::AddGlobalTestEnvironment(new phone::PutAway);
  testing::UnitTest::GetInstance()->listeners().Append(new phone::Pictures);
  return RUN_ALL_TESTS();
}
