#include "ViewerTest.h"
#include "ZQVIcons.h"

namespace {

constexpr const char* kFolder =
    "/opt/usr/apps/com.orlant.zelqo/res/images/viewer-images/WVGA/fileicon/";

class IconRules : public ViewerTest {
 protected:
  static std::string small(const char* kind) {
    return std::string(kFolder) + "80x80/zq_file_ic_" + kind + ".png";
  }
  static std::string large(const char* kind) {
    return std::string(kFolder) + "148x148/zq_file_full_ic_" + kind + ".png";
  }
};

const std::pair<const char*, const char*> kKinds[] = {
    {"application/vnd.openxmlformats-officedocument.presentationml.presentation", "ppt"},
    {"application/vnd.ms-powerpoint", "ppt"},
    {"application/vnd.ms-excel", "xls"},
    {"application/vnd.openxmlformats-officedocument.spreadsheetml.sheet", "xls"},
    {"text/plain", "text"},
    {"image/png", "img"},
    {"video/mp4", "img"},
    {"x-image/x", "img"},
    {"application/msword", "word"},
    {"application/vnd.openxmlformats-officedocument.wordprocessingml.document", "word"},
    {"application/pdf", "pdf"},
    {"text/html", "html"},
    {"text/vcard", "vcf"},
    {"text/x-vcard", "vcf"},
    {"application/x-hwp", "hwp"},
    {"text/calendar", "date"},
    {"application/vnd.android.package-archive", "etc"},
    {"application/zip", "zip"},
    {"application/octet-stream", "unknown"},
    {"unknown", "unknown"},
    {"", "unknown"},
    {"TEXT/PLAIN", "unknown"},
    {"text/plain; charset=utf-8", "unknown"},
};

TEST_F(IconRules, FollowTheTypeInBothSizes) {
  for (const auto& [type, kind] : kKinds) {
    EXPECT_EQ(taken(ZQVIcons::getIconPath(type, true)), small(kind)) << type;
    EXPECT_EQ(taken(ZQVIcons::getIconPath(type, false)), large(kind)) << type;
    EXPECT_EQ(taken(ZQVIcons::_getOthersIconPath(type, true)), small(kind)) << type;
  }
}

TEST_F(IconRules, KnowMusicOnlyForOthers) {
  EXPECT_EQ(taken(ZQVIcons::_getOthersIconPath("audio/mpeg", true)), small("music"));
  EXPECT_EQ(taken(ZQVIcons::_getOthersIconPath("audio/mpeg", false)), large("music"));
  EXPECT_EQ(taken(ZQVIcons::getIconPath("audio/mpeg", true)), small("unknown"));
}

TEST_F(IconRules, HaveNoIconForNoType) {
  EXPECT_EQ(ZQVIcons::_getOthersIconPath(nullptr, true), nullptr);
  EXPECT_EQ(errors(), Errors({"type is NULL"}));
}

TEST_F(IconRules, NameTheKindForScreenReaders) {
  EXPECT_STREQ(ZQVIcons::getKindName("video/mp4"), "video");
  EXPECT_STREQ(ZQVIcons::getKindName("audio/mpeg"), "audio");
  EXPECT_STREQ(ZQVIcons::getKindName("application/pdf"), "PDF");
  EXPECT_STREQ(ZQVIcons::getKindName(nullptr), "file");
}

}  // namespace
