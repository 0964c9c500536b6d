// The pictures of a received share: fetched once, and kept.

#include <filesystem>

#include "AlivePage.h"

namespace fs = std::filesystem;
using phone::kBlue;
using phone::kGreen;
using phone::kRed;
using phone::makePicture;
using phone::Share;
using phone::thePhone;
using phone::waitFor;

namespace {

using Thumbnails = AlivePage;

// A share of three pictures, of which everything has been fetched.
Share fetchedShare() {
  Share share = thePhone().share({makePicture(thePhone(), "Red.png", kRed),
                                  makePicture(thePhone(), "Green.jpg", kGreen),
                                  makePicture(thePhone(), "Blue.png", kBlue, 900, 600)});
  thePhone().launchReceived(share.token);
  EXPECT_TRUE(cellShows("Red.png", kRed));
  EXPECT_TRUE(waitFor([&] {
    const std::string known = thePhone()({"prefs", "list"});
    for (const char* kind : {"thumb", "mid"}) {
      for (int file = 0; file < 3; file++) {
        if (known.find(addressOf(share, kind, file)) == std::string::npos) return false;
      }
    }
    return known.find(share.token) != std::string::npos;
  })) << thePhone()({"prefs", "list"});
  return share;
}

void expectAllPictures() {
  EXPECT_TRUE(cellShows("Red.png", kRed));
  EXPECT_TRUE(cellShows("Green.jpg", kGreen));
  EXPECT_TRUE(cellShows("Blue.png", kBlue));
}

}  // namespace

TEST_F(Thumbnails, AppearInTheirCells) {
  fetchedShare();
  expectAllPictures();
}

TEST_F(Thumbnails, AreNotAskedForAgainWhenTheShareIsOpenedAgain) {
  const Share share = fetchedShare();
  const std::string before = serviceStats();
  ASSERT_NE(before, "");
  for (int i = 0; i < 2; i++) {
    thePhone().closeViewer();
    thePhone().launchReceived(share.token);
    expectAllPictures();
  }
  EXPECT_EQ(serviceStats(), before);
}

TEST_F(Thumbnails, AreThereWithoutTheService) {
  const Share share = fetchedShare();
  thePhone().closeViewer();
  thePhone()({"service", "down"});
  thePhone().launchReceived(share.token);
  expectAllPictures();
}

TEST_F(Thumbnails, ReplaceTheIconsOfAnOpenPageWhenTheServiceIsSlow) {
  const Share share = thePhone().share({makePicture(thePhone(), "Late.png", kRed)});
  thePhone()({"service", "slow", "1500"});
  thePhone().launchReceived(share.token);
  ASSERT_TRUE(comes("Late.png"));
  EXPECT_FALSE(colourOf(thePhone(), "Late.png").isAbout(kRed));
  EXPECT_TRUE(cellShows("Late.png", kRed));
}

TEST_F(Thumbnails, ThatWereDeletedAreAskedForAgainUnlessTheShareIsComplete) {
  const Share share = fetchedShare();
  thePhone().closeViewer();
  for (const auto& file : fs::directory_iterator(ofPhone(kThumbnails))) fs::remove(file);
  thePhone()({"prefs", "remove", share.token});
  const long before = serviceCount("thumb");
  thePhone().launchReceived(share.token);
  expectAllPictures();
  EXPECT_EQ(serviceCount("thumb"), before + 3);
}

TEST_F(Thumbnails, OfTwoHundredFilesAreAllFetched) {
  constexpr size_t kFiles = 200;
  const size_t before = filesIn(kThumbnails);
  const Share pictures = thePhone().share({makePicture(thePhone(), "Many.png", kGreen)});
  std::string files;
  for (size_t i = 0; i < kFiles; i++) {
    files += (i ? "," : "[") + std::string(R"({"name":"Many )") + std::to_string(i) +
             R"(.png","size":1,"type":"image/png","thumb":")" + addressOf(pictures, "thumb", 0) +
             "?" + std::to_string(i) + R"("})";
  }
  const Share share = announced(files + "]");
  thePhone().launchReceived(share.token);
  EXPECT_TRUE(
      waitFor([&] { return filesIn(kThumbnails) >= before + kFiles; }, std::chrono::seconds(60)))
      << filesIn(kThumbnails) << " of " << before + kFiles;
  EXPECT_TRUE(cellShows("Many 0.png", kGreen));
}
