#include "ZQVSharedFiles.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cstdio>
#include <fstream>

#include "PhoneTest.h"

using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;

class SharedFiles : public PhoneTest {
 protected:
  SharedFiles() : _path(testing::TempDir() + "zelqo-shared-files.json"), files(_path.c_str()) {
    remove(_path.c_str());
  }
  ~SharedFiles() override { remove(_path.c_str()); }

  /// As the file manager writes: whole, then renamed.
  void write(const std::string& content) {
    const std::string part = _path + ".part";
    std::ofstream(part, std::ios::binary) << content;
    rename(part.c_str(), _path.c_str());
  }
  std::string pathOf(const char* url) {
    const ZQVOwnedText path = files.pathOf(url);
    return path ? path.get() : "(null)";
  }

  std::string _path;
  ZQVSharedFiles files;
};

TEST_F(SharedFiles, GiveThePathRecordedForAnAddress) {
  write(R"({"http://s/1": "/opt/usr/media/Downloads/a.jpg", "http://s/2": "/x/b.jpg"})");
  EXPECT_EQ(pathOf("http://s/1"), "/opt/usr/media/Downloads/a.jpg");
  EXPECT_EQ(pathOf("http://s/2"), "/x/b.jpg");
  EXPECT_TRUE(log.lines().empty());
}

TEST_F(SharedFiles, LogANullAddress) {
  EXPECT_EQ(pathOf(nullptr), "(null)");
  EXPECT_THAT(log.errors(), ElementsAre("url is NULL"));
}

TEST_F(SharedFiles, LogTheErrorCodeWhenThereIsNoFile) {
  EXPECT_EQ(pathOf("http://s/1"), "(null)");
  EXPECT_THAT(log.errors(), ElementsAre("gRet is " + std::to_string(G_FILE_ERROR_NOENT)));
}

TEST_F(SharedFiles, LogTheErrorCodeOfBrokenContent) {
  write(R"({"http://s/1": )");
  EXPECT_EQ(pathOf("http://s/1"), "(null)");
  EXPECT_THAT(log.errors(), ElementsAre(testing::MatchesRegex("gRet is [1-9][0-9]*")));
}

TEST_F(SharedFiles, HaveNoRootWhenTheFileIsEmpty) {
  write("");
  EXPECT_EQ(pathOf("http://s/1"), "(null)");
  EXPECT_THAT(log.errors(), ElementsAre("root is NULL"));
}

TEST_F(SharedFiles, HaveNoRootWhenItIsNoObject) {
  for (const char* content : {"[\"http://s/1\"]", "\"text\"", "17", "null"}) {
    write(content);
    log.clear();
    EXPECT_EQ(pathOf("http://s/1"), "(null)");
    EXPECT_THAT(log.errors(), ElementsAre("root is NULL")) << content;
  }
}

TEST_F(SharedFiles, LogAnAddressThatIsNotThere) {
  write(R"({"http://s/1": "/x"})");
  EXPECT_EQ(pathOf("http://s/2"), "(null)");
  EXPECT_THAT(log.errors(), ElementsAre("fullpath is NULL"));
}

TEST_F(SharedFiles, TakeMembersThatAreNoTextsForMissing) {
  write(R"({"n": 1, "b": true, "a": ["/x"], "o": {"p": "/x"}, "z": null})");
  for (const char* url : {"n", "b", "a", "o", "z"}) {
    log.clear();
    EXPECT_EQ(pathOf(url), "(null)") << url;
    EXPECT_THAT(log.errors(), ElementsAre("fullpath is NULL")) << url;
  }
}

TEST_F(SharedFiles, NoticeThatTheFileHasChanged) {
  write(R"({"http://s/1": "/old"})");
  EXPECT_EQ(pathOf("http://s/1"), "/old");
  write(R"({"http://s/1": "/new"})");
  EXPECT_EQ(pathOf("http://s/1"), "/new");
  remove(_path.c_str());
  EXPECT_EQ(pathOf("http://s/1"), "(null)");
}

TEST_F(SharedFiles, RefuseNoise) {
  std::string noise;
  for (int i = 0; i < 100000; ++i) noise.push_back(static_cast<char>(i * 7919 >> 3));
  write(noise);
  EXPECT_EQ(pathOf("http://s/1"), "(null)");
  EXPECT_THAT(log.errors(), ElementsAre(HasSubstr("gRet is ")));
}

TEST_F(SharedFiles, SurviveAnyDepthOfNesting) {
  for (const char* bracket : {"[", "{\"a\":", "/*\"*/[", "'\"'["}) {
    std::string deep;
    for (int i = 0; i < 300000; ++i) deep.append(bracket);
    write(deep);
    EXPECT_EQ(pathOf("http://s/1"), "(null)") << bracket;
  }
}

TEST_F(SharedFiles, AreOneDocument) {
  for (const char* content : {"{}{}", "{}, {}", "17 18", "{}]} [{", "var x = {}"}) {
    write(content);
    log.clear();
    EXPECT_EQ(pathOf("http://s/1"), "(null)");
    EXPECT_THAT(log.errors(), ElementsAre(HasSubstr("gRet is "))) << content;
  }
}

TEST_F(SharedFiles, MayEscapeTheirLettersButNotHalfAPair) {
  write(R"({"http://s/1": "/x/\ud83d\uDE00.jpg"})");
  EXPECT_EQ(pathOf("http://s/1"), "/x/\xF0\x9F\x98\x80.jpg");
  for (const char* half : {R"(\ud83d)", R"(\uD83D\u0041)", R"(\ud83d\ud83d)", R"(\ud83d\ude0)",
                           R"(\uda\)", R"(\ude00)", R"(\ude00\ud83d)", R"(\u)"}) {
    write(std::string("{\"http://s/1\": \"") + half + "\"}");
    log.clear();
    EXPECT_EQ(pathOf("http://s/1"), "(null)") << half;
    EXPECT_THAT(log.errors(), ElementsAre(HasSubstr("gRet is "))) << half;
  }
}

TEST_F(SharedFiles, AreReadEvenWhenNamesHoldBracketsAndQuotes) {
  write(R"({"http://s/1": "/x/\"[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[.jpg"})");
  EXPECT_EQ(pathOf("http://s/1"), "/x/\"[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[[.jpg");
}

TEST_F(SharedFiles, RefuseAFileThatIsFarTooLarge) {
  write("{");
  ASSERT_EQ(truncate(_path.c_str(), 50 << 20), 0);
  EXPECT_EQ(pathOf("http://s/1"), "(null)");
  EXPECT_THAT(log.errors(), Contains(HasSubstr("is not a list of files")));
}

TEST_F(SharedFiles, DoNotWaitForAPipe) {
  ASSERT_EQ(mkfifo(_path.c_str(), 0600), 0);
  EXPECT_EQ(pathOf("http://s/1"), "(null)");
  EXPECT_THAT(log.errors(), Contains(HasSubstr("gRet is ")));
}

TEST_F(SharedFiles, AreQuickToAskForEveryFileOfALargeShare) {
  std::string content = "{";
  for (int i = 0; i < 10000; ++i) {
    content += (i ? "," : "") + ("\"http://s/" + std::to_string(i)) + "\": \"/x/" +
               std::to_string(i) + "\"";
  }
  write(content + "}");
  for (int i = 0; i < 10000; ++i) {
    ASSERT_EQ(pathOf(("http://s/" + std::to_string(i)).c_str()), "/x/" + std::to_string(i));
  }
}
