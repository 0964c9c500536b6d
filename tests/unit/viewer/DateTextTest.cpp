#include <unicode/uloc.h>

#include <cstdlib>

#include "ViewerTest.h"
#include "ZQVCommon.h"

namespace {

constexpr double kNoon = 1700000000000.0;  // 14 November 2023, UTC

class DateText : public ViewerTest {
 protected:
  static std::string of(const char* locale, const UChar* skeleton = u"yMd", double time = kNoon) {
    return taken(ZQViewerCommon::getInstance().getDateString(locale, skeleton, time));
  }
};

TEST_F(DateText, FollowsTheRegion) {
  EXPECT_EQ(of("en_GB"), "14/11/2023");
  EXPECT_EQ(of("en_US"), "11/14/2023");
  EXPECT_EQ(of("de_DE"), "14.11.2023");
}

TEST_F(DateText, IgnoresTheCodesetOfTheRegion) {
  EXPECT_EQ(of("en_GB.UTF-8"), of("en_GB"));
}

TEST_F(DateText, IsUtf8) {
  EXPECT_EQ(of("ko_KR", u"yMMMd"), "2023년 11월 14일");
}

TEST_F(DateText, OfNoTimeIsNothing) {
  EXPECT_EQ(of("en_GB", u"yMd", 0.0), "(null)");
}

TEST_F(DateText, WithoutASkeletonIsEmpty) {
  EXPECT_EQ(of("en_GB", u""), "");
}

TEST_F(DateText, TakesTheRegionBeforeTheEnvironment) {
  setenv("LC_TIME", "en_US", 1);
  EXPECT_EQ(of("de_DE"), "14.11.2023");
  EXPECT_STREQ(uloc_getDefault(), "en_US");
  unsetenv("LC_TIME");
}

TEST_F(DateText, WithoutARegionFollowsTheEnvironment) {
  setenv("LC_TIME", "en_US", 1);
  EXPECT_EQ(of(nullptr), "11/14/2023");
  unsetenv("LC_TIME");
}

TEST_F(DateText, SurvivesARegionThatIsNone) {
  EXPECT_EQ(of("this is no locale at all, is it?"), "");
  EXPECT_EQ(of(std::string(5000, 'x').c_str()), "");
  setenv("LC_TIME", "neither is this one, and it is long", 1);
  EXPECT_EQ(of("en_GB"), "14/11/2023");
  unsetenv("LC_TIME");
}

TEST_F(DateText, SurvivesTimesBeyondTheCalendar) {
  EXPECT_NO_FATAL_FAILURE(of("en_GB", u"yMd", 1e300));
  EXPECT_NO_FATAL_FAILURE(of("en_GB", u"yMd", -1e18));
}

}  // namespace
