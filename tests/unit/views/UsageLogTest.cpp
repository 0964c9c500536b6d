#include "ZQVOrlantLog.h"

#include <app_control_internal.h>

#include "PhoneTest.h"
#include "ZQVOwned.h"

using testing::ElementsAre;
using testing::IsEmpty;
using testing::Pair;

class UsageLog : public PhoneTest {
 protected:
  /// The first use of the log creates it; these tests speak of later uses.
  UsageLog() {
    ZQVOrlantLog::getInstance();
    phone.reset();
    log.clear();
  }

  std::string entryPath(const char* caller, int entry) {
    phone.reset();
    phone.caller = caller;
    ZQVOwnedAppControl request;
    app_control_create(request.out());
    ZQVOrlantLog::getInstance().insertEntryPath(request.get(), entry);
    return phone.usage.size() == 1 ? phone.usageOf("ZQ50").at(0) : "";
  }
  std::vector<std::string> categoryOf(const char* extension) {
    phone.reset();
    ZQVOrlantLog::getInstance().insertSelectDownloadContentstype(&extension, 1);
    return phone.usageOf("ZQ51");
  }
  std::vector<std::string> countBucket(int count) {
    phone.reset();
    ZQVOrlantLog::getInstance().insertSelectDownloadCount(count);
    return phone.usageOf("ZQ52");
  }
  std::vector<std::string> sizeBucket(uint32_t bytes) {
    phone.reset();
    ZQVOrlantLog::getInstance().insertSelectDownloadSize(bytes);
    return phone.usageOf("ZQ53");
  }
};

TEST_F(UsageLog, RecordsCarryApplicationFeatureAndExtra) {
  ZQVOrlantLog::getInstance().insertSelectDownloadCount(1);
  ASSERT_EQ(phone.usage.size(), 1u);
  EXPECT_TRUE(phone.usage[0].hasHandle);
  EXPECT_THAT(phone.usage[0].uri, testing::EndsWith("/log/use_app_feature_survey"));
  EXPECT_THAT(phone.usage[0].entries, ElementsAre(Pair("app_id", "com.orlant.zelqo"),
                                                  Pair("feature", "ZQ52"), Pair("extra", "1_10")));
}

TEST_F(UsageLog, RecallAndReshareHaveNoExtra) {
  ZQVOrlantLog::getInstance().insertRecall();
  ZQVOrlantLog::getInstance().insertReshare();
  ASSERT_EQ(phone.usage.size(), 2u);
  EXPECT_THAT(phone.usage[0].entries,
              ElementsAre(Pair("app_id", "com.orlant.zelqo"), Pair("feature", "ZQ57")));
  EXPECT_THAT(phone.usage[1].entries,
              ElementsAre(Pair("app_id", "com.orlant.zelqo"), Pair("feature", "ZQ58")));
}

TEST_F(UsageLog, NamesTheEntryPathByCallerAndKindOfShare) {
  EXPECT_EQ(entryPath("com.orlant.message-lite", 3), "Enhanced message_sender");
  EXPECT_EQ(entryPath("com.orlant.message-lite", 4), "Enhanced message_receiver");
  EXPECT_EQ(entryPath("com.orlant.zelqo-history", 3), "Shared_history_sent");
  EXPECT_EQ(entryPath("com.orlant.zelqo-history", 4), "Shared_history_received");
  EXPECT_EQ(entryPath("com.orlant.myfile-download-manager", 3), "Download_history");
  EXPECT_EQ(entryPath("com.orlant.myfile-download-manager", 4), "Download_history");
  EXPECT_EQ(entryPath("com.orlant.other", 3), "Push_notification");
  EXPECT_EQ(entryPath("", 4), "Push_notification");
  EXPECT_EQ(entryPath("com.orlant.Message-Lite", 3), "Push_notification");
}

TEST_F(UsageLog, TakesAnyOtherEntryForAReceivedShare) {
  EXPECT_EQ(entryPath("com.orlant.message-lite", 0), "Enhanced message_receiver");
}

TEST_F(UsageLog, LogsAMissingRequest) {
  ZQVOrlantLog::getInstance().insertEntryPath(nullptr, 3);
  EXPECT_THAT(log.errors(), ElementsAre("request is NULL"));
  EXPECT_THAT(phone.usage, IsEmpty());
}

TEST_F(UsageLog, PutsExtensionsIntoCategories) {
  EXPECT_THAT(categoryOf("mpeg"), ElementsAre("Video"));     // 0
  EXPECT_THAT(categoryOf("smi"), ElementsAre("Video"));      // 24
  EXPECT_THAT(categoryOf("mp3"), ElementsAre("Audio"));      // 25
  EXPECT_THAT(categoryOf("flac"), ElementsAre("Audio"));     // 56
  EXPECT_THAT(categoryOf("jpeg"), ElementsAre("Photo"));     // 57
  EXPECT_THAT(categoryOf("wbmp"), ElementsAre("Photo"));     // 64
  EXPECT_THAT(categoryOf("ppt"), ElementsAre("Document"));   // 65
  EXPECT_THAT(categoryOf("pdf"), ElementsAre("Document"));   // 73
  EXPECT_THAT(categoryOf("html"), ElementsAre("Document"));  // 75
  EXPECT_THAT(categoryOf("vcf"), ElementsAre("Contact"));    // 77
  EXPECT_THAT(categoryOf("vcs"), ElementsAre("Plandex"));    // 78
  EXPECT_THAT(categoryOf("vts"), ElementsAre("Plandex"));    // 79
  EXPECT_THAT(categoryOf("qqq"), IsEmpty());
  EXPECT_THAT(categoryOf("invalid"), IsEmpty());
}

TEST_F(UsageLog, CountsPlainTextAsMemoNotDocument) {
  EXPECT_THAT(categoryOf("txt"), ElementsAre("Memo"));
}

TEST_F(UsageLog, WritesOneRecordPerFileWithACategory) {
  const char* extensions[] = {"jpg", "qqq", "mp4", "jpg"};
  ZQVOrlantLog::getInstance().insertSelectDownloadContentstype(extensions, 4);
  EXPECT_THAT(phone.usageOf("ZQ51"), ElementsAre("Photo", "Video", "Photo"));
}

TEST_F(UsageLog, PutsCountsIntoBuckets) {
  EXPECT_THAT(countBucket(0), IsEmpty());
  EXPECT_THAT(countBucket(-1), IsEmpty());
  EXPECT_THAT(countBucket(1), ElementsAre("1_10"));
  EXPECT_THAT(countBucket(10), ElementsAre("1_10"));
  EXPECT_THAT(countBucket(11), ElementsAre("11_50"));
  EXPECT_THAT(countBucket(50), ElementsAre("11_50"));
  EXPECT_THAT(countBucket(51), ElementsAre("51_100"));
  EXPECT_THAT(countBucket(100), ElementsAre("51_100"));
  EXPECT_THAT(countBucket(101), IsEmpty());
}

TEST_F(UsageLog, PutsSizesIntoBuckets) {
  EXPECT_THAT(sizeBucket(0), ElementsAre("0_100MB"));
  EXPECT_THAT(sizeBucket(104857599), ElementsAre("0_100MB"));
  EXPECT_THAT(sizeBucket(104857600), ElementsAre("100MB_500MB"));
  EXPECT_THAT(sizeBucket(524287999), ElementsAre("100MB_500MB"));
  EXPECT_THAT(sizeBucket(524288000), ElementsAre("500MB_1GB"));
  EXPECT_THAT(sizeBucket(1073741824), ElementsAre("500MB_1GB"));
  EXPECT_THAT(sizeBucket(1073741825), IsEmpty());
  EXPECT_THAT(sizeBucket(4294967295u), IsEmpty());
}

TEST_F(UsageLog, UsesTheSameBucketsForTheFullView) {
  ZQVOrlantLog::getInstance().insertFullDownloadSize(104857600);
  ZQVOrlantLog::getInstance().insertFullDownloadSize(1073741825);
  EXPECT_THAT(phone.usageOf("ZQ55"), ElementsAre("100MB_500MB"));
}

TEST_F(UsageLog, RecordsFullViewFilesByNameEvenWithoutACategory) {
  ZQVOrlantLog::getInstance().insertFullDownloadContentstype("photo.JPG");
  ZQVOrlantLog::getInstance().insertFullDownloadContentstype("README");
  ZQVOrlantLog::getInstance().insertFullOpenContentstype("/opt/usr/media/Downloads/song.mp3");
  ZQVOrlantLog::getInstance().insertFullOpenContentstype("/a.b/noextension");
  EXPECT_THAT(phone.usageOf("ZQ54"), ElementsAre("Photo", ""));
  EXPECT_THAT(phone.usageOf("ZQ56"), ElementsAre("Audio", ""));
}

TEST_F(UsageLog, LogsAMissingFileName) {
  ZQVOrlantLog::getInstance().insertFullDownloadContentstype(nullptr);
  ZQVOrlantLog::getInstance().insertFullOpenContentstype(nullptr);
  EXPECT_THAT(log.errors(), ElementsAre("file_name is NULL", "file_name is NULL"));
  EXPECT_THAT(phone.usage, IsEmpty());
}
