// Pictures as they are to be seen on their pages.

#include "FullPage.h"

using phone::kGreen;
using phone::thePhone;
using phone::waitFor;

namespace {

using Pictures = FullPage;

constexpr phone::Area kMiddleRow{0, 650, 720, 1};
constexpr phone::Colour kShownRed{254, 0, 0};
constexpr phone::Colour kShownBlue{0, 0, 254};
/// Of stripes on a picture of fewer pixels than the screen there is next to nothing left.
constexpr int kSharp = 60;

bool turns(const phone::Colour& colour) {
  return waitFor([&] { return phone::colourAt(thePhone(), 360, 650).isAbout(colour); });
}

bool plays() {
  return turns(kShownRed) && turns(kShownBlue) && turns(kShownRed) && turns(kShownBlue);
}

testing::AssertionResult isSharp() {
  int contrast = 0;
  const auto becomesSharp = [&contrast] {
    contrast = phone::contrastIn(thePhone(), kMiddleRow);
    return contrast > kSharp;
  };
  if (waitFor(becomesSharp)) return testing::AssertionSuccess();
  return testing::AssertionFailure() << "the contrast is " << contrast;
}

}  // namespace

TEST_F(Pictures, HaveAsManyPixelsAsTheScreen) {
  openSent({phone::makeStripes(thePhone(), "Fence.jpg"),
            phone::makePicture(thePhone(), "Lawn.jpg", kGreen),
            phone::makeStripes(thePhone(), "Wall.jpg")},
           "Fence.jpg");
  EXPECT_TRUE(isSharp()) << "on the page that was opened";
  swipeForth();
  ASSERT_TRUE(pageIs("Lawn.jpg"));
  swipeForth();
  ASSERT_TRUE(pageIs("Wall.jpg"));
  EXPECT_TRUE(isSharp()) << "on a page that was turned to";
}

TEST_F(Pictures, PlayWhenTheyMove) {
  openSent(
      {phone::makePicture(thePhone(), "Lawn.jpg", kGreen),
       phone::makeAnimation(thePhone(), "Wave.gif"), phone::makeAnimation(thePhone(), "Wink.webp")},
      "Lawn.jpg");
  for (const char* name : {"Wave.gif", "Wink.webp"}) {
    SCOPED_TRACE(name);
    swipeForth();
    ASSERT_TRUE(pageIs(name));
    EXPECT_TRUE(plays());
  }
}
