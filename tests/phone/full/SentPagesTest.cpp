// The pages of a sent share: its files are opened, never downloaded.

#include <filesystem>
#include <fstream>

#include "FullPage.h"

namespace fs = std::filesystem;
using phone::kBlue;
using phone::thePhone;
using phone::waitFor;

namespace {

using SentPages = FullPage;

}  // namespace

TEST_F(SentPages, OfferToOpenAFileThatIsOnThePhone) {
  const std::string file = phone::makePicture(thePhone(), "Lake.png", kBlue);
  openSent({file}, "Lake.png");
  ASSERT_TRUE(buttonIsEnabled("Open"));
  EXPECT_TRUE(waitFor([] { return phone::colourAt(thePhone(), 360, 640).isAbout(kBlue); }))
      << phone::colourAt(thePhone(), 360, 640);
  ASSERT_TRUE(tap("Open"));
  EXPECT_TRUE(waitFor([&] {
    return thePhone()({"launches", "--all"}).find("Lake.png\"") != std::string::npos;
  }));
}

TEST_F(SentPages, OfferNothingForAFileThatOnlyTheServiceKeeps) {
  const std::string held = "/opt/usr/apps/com.orlant.zelqo/shared/data/Held.txt";
  std::ofstream(ofPhone(held)) << "content";
  const std::string own = thePhone().makeFile("Own.txt");
  thePhone()({"launch", "raw", "launch_viewer", "freemsg_send_data[]=" + held,
              "freemsg_send_data[]=" + own});
  ASSERT_TRUE(tap("Own.txt"));
  ASSERT_TRUE(pageIs("Own.txt"));
  thePhone()({"painted"});
  EXPECT_TRUE(buttonIsEnabled("Open"));
  swipeBack();
  ASSERT_TRUE(pageIs("Held.txt"));
  EXPECT_TRUE(buttonIsDisabled("Open"));
  swipeForth();
  ASSERT_TRUE(pageIs("Own.txt"));
  EXPECT_TRUE(buttonIsEnabled("Open"));
  fs::remove(ofPhone(held));
}

TEST_F(SentPages, LeaveOutAFileThatIsMissing) {
  const std::string gone = thePhone().makeFile("Gone.txt");
  const std::string kept = thePhone().makeFile("Kept.txt");
  const phone::Share share = thePhone().shareTo("+821011112222", "+821012345678", {gone, kept});
  fs::remove(gone);
  thePhone()({"launch", "sent", "--request", std::to_string(share.request)});
  ASSERT_TRUE(tap("Kept.txt"));
  EXPECT_TRUE(pageIs("Kept.txt"));
  EXPECT_EQ(thePhone().tree().items().size(), 1u) << thePhone().tree();
}

TEST_F(SentPages, KeepTheButtonsTextWhenTheLanguageChanges) {
  openSent({thePhone().makeFile("Words.txt")}, "Words.txt");
  thePhone()({"language", "de_DE.UTF-8"});
  EXPECT_TRUE(buttonIsEnabled("Öffnen"));
  thePhone()({"language", "en_US.UTF-8"});
  EXPECT_TRUE(buttonIsEnabled("Open"));
}
