#include "Pictures.h"

#include <cstdlib>

#include "ServiceFixture.h"

namespace {

class MadePictures : public ServiceTest {
 protected:
  Decoded fetch(const TestShare& share, const char* kind, int index = 0) {
    return decode(httpGet(address(share, std::string(kind) + "/" + std::to_string(index))).body);
  }
};

TEST_F(MadePictures, ComeInThreeSizes) {
  const TestShare shared = share({{"a.jpg", "image/jpeg", encodedPicture(2400, 1800, "jpeg")}});
  EXPECT_EQ(fetch(shared, "thumb").width, 320);
  EXPECT_EQ(fetch(shared, "thumb").height, 240);
  EXPECT_EQ(fetch(shared, "mid").width, 1280);
  EXPECT_EQ(fetch(shared, "big").width, 1600);
  const HttpAnswer thumb = httpGet(address(shared, "thumb/0"));
  EXPECT_EQ(thumb.body.substr(0, 3), "\xff\xd8\xff");
  EXPECT_EQ(thumb.headers.at("Content-Type"), "image/jpeg");
}

TEST_F(MadePictures, AreNeverEnlarged) {
  const TestShare shared = share({{"a.png", "image/png", encodedPicture(100, 50, "png")}});
  for (const char* kind : {"thumb", "mid", "big"}) {
    EXPECT_EQ(fetch(shared, kind).width, 100) << kind;
    EXPECT_EQ(fetch(shared, kind).height, 50) << kind;
  }
}

TEST_F(MadePictures, AreWhiteWhereTheFileIsClear) {
  const TestShare shared = share({{"a.png", "image/png", clearPicture(400, 300)}});
  EXPECT_TRUE(fetch(shared, "thumb").isWhiteUpperLeft);
  EXPECT_TRUE(fetch(shared, "mid").isWhiteUpperLeft);
}

TEST_F(MadePictures, StandUpright) {
  const TestShare shared = share({{"a.jpg", "image/jpeg", turnedJpeg(800, 400)}});
  const Decoded thumb = fetch(shared, "thumb");
  EXPECT_EQ(thumb.width, 160);
  EXPECT_EQ(thumb.height, 320);
  EXPECT_TRUE(thumb.isRedUpperRight);
  EXPECT_FALSE(thumb.isRedUpperLeft);
}

TEST_F(MadePictures, OfAVeryNarrowOneKeepAPixel) {
  const TestShare shared = share({{"a.png", "image/png", encodedPicture(4000, 2, "png")}});
  EXPECT_EQ(fetch(shared, "thumb").width, 320);
  EXPECT_EQ(fetch(shared, "thumb").height, 1);
}

TEST_F(MadePictures, AreMissingForWhatIsNoPicture) {
  const std::string jpeg = encodedPicture(800, 600, "jpeg");
  const TestShare shared =
      share({{"a.png", "image/png", "not a picture"},
             {"b.png", "image/png", ""},
             {"c.png", "image/png", pngClaiming(32768, 32768)},
             {"d.png", "image/png", pngClaiming(8193, 1)},
             {"e.png", "image/png", pngClaiming(8000, 8000)},
             {"f.mp4", "video/mp4", "not a video"},
             {"g.mp4", "video/mp4", "#EXTM3U\n#EXTINF:1,\nfile:///etc/passwd\n"},
             {"h.txt", "text/plain", jpeg},
             {"i.jpg", "image/jpeg", jpeg}});
  for (int i = 0; i < 8; i++) {
    EXPECT_EQ(httpGet(address(shared, "thumb/" + std::to_string(i))).status, 404U) << i;
  }
  EXPECT_EQ(fetch(shared, "thumb", 8).width, 320);
  const std::string manifest = httpGet(address(shared, "manifest.json")).body;
  EXPECT_EQ(manifest.find("\"thumb/7\""), std::string::npos);
  EXPECT_NE(manifest.find("\"thumb/8\""), std::string::npos);
}

TEST_F(MadePictures, ShowAFrameOfAVideo) {
  const TempFolder folder;
  const std::string file = folder.path("v.mp4");
  const std::string command = "ffmpeg -loglevel error -f lavfi -i color=red:size=640x360:d=1 " +
                              file + " >/dev/null 2>&1 </dev/null";
  if (system(command.c_str()) != 0) GTEST_SKIP() << "ffmpeg makes the video, and is not there";
  const TestShare shared = share({{"v.mp4", "video/mp4", readAll(file)}});
  EXPECT_EQ(fetch(shared, "thumb").width, 320);
  EXPECT_EQ(fetch(shared, "thumb").height, 180);
  EXPECT_EQ(fetch(shared, "mid").width, 640);
  EXPECT_TRUE(fetch(shared, "mid").isRedUpperLeft);
}

// The decoder is a process of its own, so that what kills it kills nothing else.
TEST_F(MadePictures, AreMadeAgainAfterTheDecoderEnded) {
  share({{"a.png", "image/png", encodedPicture(100, 50, "png")}});
  const std::string kill = "pkill -KILL -P " + std::to_string(service().pid());
  ASSERT_EQ(system(kill.c_str()), 0);
  bool again = false;
  for (int i = 0; i < 8 && !again; i++) {
    again = fetch(share({{"a.png", "image/png", encodedPicture(100, 50, "png")}}), "thumb").width;
  }
  EXPECT_TRUE(again);
}

}  // namespace
