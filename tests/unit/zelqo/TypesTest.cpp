#include <gtest/gtest.h>

#include "FileType.h"
#include "PictureKind.h"
#include "TempFolder.h"

namespace zelqo {
namespace {

TEST(PictureKind, IsToldByTheFirstBytes) {
  const auto extension = [](const std::string& head) {
    const char* text = pictureExtension(head.data(), head.size());
    return std::string(text ? text : "none");
  };
  EXPECT_EQ(extension("\x89PNG\r\n\x1a\n...."), ".png");
  EXPECT_EQ(extension("\xff\xd8\xff\xe0"), ".jpg");
  EXPECT_EQ(extension("GIF89a"), ".gif");
  EXPECT_EQ(extension("GIF87a"), ".gif");
  EXPECT_EQ(extension("RIFF....WEBP"), ".webp");
  EXPECT_EQ(extension("RIFF....WAVE"), "none");
  EXPECT_EQ(extension("RIFF"), "none");
  EXPECT_EQ(extension("\x89PNG"), "none");
  EXPECT_EQ(extension("<svg"), "none");
  EXPECT_EQ(extension(""), "none");
}

TEST(FileType, IsToldByTheName) {
  const TempFolder folder;
  EXPECT_EQ(fileType("/x/a.JPG"), "image/jpeg");
  EXPECT_EQ(fileType("/x/a.pdf"), "application/pdf");
  EXPECT_EQ(fileType("/x/a.ts"), "video/mp2t");
  EXPECT_EQ(fileType("/x/a.3ga"), "audio/3gpp");
  EXPECT_EQ(fileType(folder.write("nameless", "\x89PNG\r\n\x1a\n")), "image/png");
  EXPECT_EQ(fileType("/x/there-is-none"), "application/octet-stream");
}

}  // namespace
}  // namespace zelqo
