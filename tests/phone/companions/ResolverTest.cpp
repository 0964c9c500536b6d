#include <fstream>

#include "Companions.h"

using phone::Share;
using phone::thePhone;
using phone::waitFor;

namespace {

class Opening : public testing::Test {
 protected:
  void TearDown() override {
    thePhone().closeViewer();
    thePhone().end({"l3afpad", "gpicview"});
  }

  static std::string put(const std::string& name, const std::string& content) {
    std::ofstream(ofPhone("/opt/usr/media/Downloads/" + name), std::ios::binary) << content;
    return "/opt/usr/media/Downloads/" + name;
  }

  static void resolve(const std::string& path) {
    thePhone()({"launch", "raw", "view", "--app", "com.orlant.resolver", "--uri", path});
  }

  static bool showsWindow(const std::string& title) {
    return waitFor([&] {
      return thePhone()
                 .command({"shell", "xdotool", "search", "--onlyvisible", "--name", title})
                 .status == 0;
    });
  }
};

}  // namespace

TEST_F(Opening, ATextShowsItInATextViewer) {
  resolve(put("odd 100%s; $(touch x).txt", "Just words.\n"));
  EXPECT_TRUE(showsWindow("odd 100%s"));
}

TEST_F(Opening, AProgramStartsNothing) {
  resolve(put("run.txt", "#!/bin/sh\n"));
  EXPECT_TRUE(waitFor([] {
    return thePhone().log("com.orlant.resolver").find("run.txt: no program") != std::string::npos;
  }));
}

TEST_F(Opening, ADownloadedScriptFromTheViewerGivesAMessage) {
  const std::string script = thePhone().makeFile("script.txt", 0);
  std::ofstream(script) << "#!/bin/sh\necho gotcha\n";
  const Share share = thePhone().share({script});
  thePhone().launchReceived(share.token);
  ASSERT_TRUE(tap("Download"));
  ASSERT_TRUE(tap("script.txt"));
  ASSERT_TRUE(tap("Done"));
  ASSERT_TRUE(says("script.txt downloaded"));
  ASSERT_TRUE(tap("script.txt"));
  ASSERT_TRUE(tap("Open"));
  EXPECT_TRUE(says("No app found for this action."));
}
