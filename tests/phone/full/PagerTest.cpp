// One file per page, and the way from page to page.

#include <fstream>

#include "FullPage.h"

using phone::thePhone;
using phone::waitFor;

namespace {

using Pager = FullPage;

std::string file(int number) {
  return "File " + std::to_string(number) + ".txt";
}

std::string manifestOf(int files) {
  std::string json;
  for (int i = 1; i <= files; i++) {
    json += (i > 1 ? R"(,{"name":")" : R"([{"name":")") + file(i) +
            R"(","size":1,"type":"text/plain"})";
  }
  std::string path = thePhone().makeFile("manifest.json", 0);
  std::ofstream(path) << json << ']';
  return path;
}

// Is the file the page, on a phone that lies or stands as it was turned?
testing::AssertionResult fillsTheScreen(const std::string& name, const std::string& turn) {
  const bool lies = turn != "0";
  const auto fills = [&] {
    const phone::Tree tree = thePhone().tree();
    return pageOn(tree).rfind(name + ", ", 0) == 0 &&
           (pageArea(tree).height == tree.widgets().front().area.height) == lies;
  };
  if (waitFor(fills)) return testing::AssertionSuccess();
  return testing::AssertionFailure() << "not \"" << name << "\" on\n" << thePhone().tree();
}

}  // namespace

TEST_F(Pager, ShowsTheFileThatWasTapped) {
  openReceived(numberedFiles(9), file(5));
}

TEST_F(Pager, MovesOnePageWithASwipe) {
  openReceived(numberedFiles(4), file(2));
  swipeForth();
  EXPECT_TRUE(pageIs(file(3)));
  swipeBack();
  EXPECT_TRUE(pageIs(file(2)));
}

TEST_F(Pager, MovesOnePageWithALightFlick) {
  openReceived(numberedFiles(4), file(2));
  thePhone()({"swipe", "430,640", "290,640", "80"});
  EXPECT_TRUE(pageIs(file(3)));
}

TEST_F(Pager, MovesNoFurtherThanOnePageWithAFastSwipe) {
  openReceived(numberedFiles(6), file(1));
  thePhone()({"swipe", "700,640", "20,640", "40"});
  EXPECT_TRUE(pageIs(file(2)));
}

TEST_F(Pager, StaysOnItsPageAfterAShortPull) {
  openReceived(numberedFiles(3), file(2));
  thePhone()({"swipe", "400,640", "310,640", "600"});
  EXPECT_TRUE(pageIs(file(2)));
}

TEST_F(Pager, GoesTenPagesForthAndBack) {
  openReceived(numberedFiles(12), file(1));
  for (int page = 2; page <= 11; page++) {
    swipeForth();
    ASSERT_TRUE(pageIs(file(page)));
  }
  for (int page = 10; page >= 1; page--) {
    swipeBack();
    ASSERT_TRUE(pageIs(file(page)));
  }
}

TEST_F(Pager, EndsAtTheFirstAndTheLastFile) {
  openReceived(numberedFiles(2), file(1));
  swipeBack();
  thePhone()({"painted"});
  EXPECT_TRUE(pageIs(file(1)));
  swipeForth();
  EXPECT_TRUE(pageIs(file(2)));
  swipeForth();
  thePhone()({"painted"});
  EXPECT_TRUE(pageIs(file(2)));
}

TEST_F(Pager, StaysOnTheSeventhPageWhenThePhoneIsTurned) {
  openReceived(numberedFiles(9), file(7));
  for (const char* turn : {"90", "0", "270", "0"}) {
    SCOPED_TRACE(turn);
    thePhone()({"rotate", turn});
    ASSERT_TRUE(fillsTheScreen(file(7), turn));
  }
}

TEST_F(Pager, FollowsASwipeOnAPhoneThatLies) {
  openReceived(numberedFiles(3), file(2));
  thePhone()({"rotate", "90"});
  ASSERT_TRUE(pageIs(file(2)));
  thePhone()({"painted"});
  thePhone()({"swipe", "370,250", "370,1050", "250"});
  EXPECT_TRUE(pageIs(file(3)));
}

TEST_F(Pager, RunsFromRightToLeftInArabic) {
  thePhone()({"language", "ar_EG.UTF-8"});
  openReceived(numberedFiles(9), file(5));
  swipeBack();
  ASSERT_TRUE(pageIs(file(6)));
  swipeForth();
  ASSERT_TRUE(pageIs(file(5)));
  swipeForth();
  ASSERT_TRUE(pageIs(file(4)));
  for (const char* turn : {"90", "0"}) {
    SCOPED_TRACE(turn);
    thePhone()({"rotate", turn});
    EXPECT_TRUE(fillsTheScreen(file(4), turn));
  }
  swipeBack();
  EXPECT_TRUE(pageIs(file(5)));
  thePhone()({"language", "en_US.UTF-8"});
  ASSERT_TRUE(buttonIsEnabled("Download"));
  EXPECT_TRUE(pageIs(file(5)));
  swipeForth();
  EXPECT_TRUE(pageIs(file(6)));
}

TEST_F(Pager, NamesItsPagesAndButtonsInTheLanguageOfNow) {
  openReceived(numberedFiles(2), file(1));
  thePhone()({"language", "de_DE.UTF-8"});
  EXPECT_TRUE(comes("Zurück"));
  EXPECT_TRUE(comes(file(1) + ", 10,0B, Text, nicht heruntergeladen"));
  EXPECT_TRUE(comes(file(2) + ", 10,0B, Text, nicht heruntergeladen"));
}

TEST_F(Pager, FindsThePageAmongFiveThousand) {
  constexpr int kFiles = 5000;
  thePhone().launchReceived(thePhone().share({}, {"--raw-manifest", manifestOf(kFiles)}).token);
  ASSERT_TRUE(waitFor([] { return thePhone().tree().named(file(1)) != nullptr; },
                      std::chrono::seconds(60)));
  EXPECT_TRUE(thePhone().tree().items().front().is("showing"))
      << "the page does not begin at its top";
  for (int i = 0; i < 3; i++) thePhone()({"swipe", "360,1100", "360,300", "60"});
  thePhone()({"painted"});
  thePhone()({"tap", "360,700"});
  std::string first;
  ASSERT_TRUE(waitFor([&] { return !(first = pageOn(thePhone().tree())).empty(); }));
  const int number = std::stoi(first.substr(first.find(' ')));
  EXPECT_GT(number, 12) << "the page below did not move";
  swipeForth();
  EXPECT_TRUE(pageIs(file(number + 1)));
}

TEST_F(Pager, ReturnsToTheShareOnBack) {
  openReceived(numberedFiles(3), file(2));
  thePhone()({"key", "Escape"});
  EXPECT_TRUE(comes("Files from"));
}
