// The drawings as the applications find them.
#include <gdk-pixbuf/gdk-pixbuf.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <filesystem>
#include <memory>
#include <set>
#include <string>
#include <vector>

namespace {

const std::string kFolder = IMAGE_DIR "/apps/com.orlant.zelqo/res/images/viewer-images/WVGA/";

struct Unref {
  void operator()(GdkPixbuf* picture) const { g_object_unref(picture); }
};
using Picture = std::unique_ptr<GdkPixbuf, Unref>;

/// Red, green, blue and alpha, row by row without padding.
struct Pixels {
  int width = 0;
  int height = 0;
  std::vector<guchar> values;

  int alphaAt(int x, int y) const { return values[(y * width + x) * 4 + 3]; }
};

Pixels pixelsOf(const std::string& name) {
  Picture picture(gdk_pixbuf_new_from_file((kFolder + name).c_str(), nullptr));
  EXPECT_TRUE(picture) << name;
  if (!picture) return {};
  Picture withAlpha(gdk_pixbuf_add_alpha(picture.get(), FALSE, 0, 0, 0));
  Pixels pixels{gdk_pixbuf_get_width(withAlpha.get()), gdk_pixbuf_get_height(withAlpha.get()), {}};
  const guchar* rows = gdk_pixbuf_read_pixels(withAlpha.get());
  for (int y = 0; y < pixels.height; ++y) {
    const guchar* row = rows + ptrdiff_t{y} * gdk_pixbuf_get_rowstride(withAlpha.get());
    pixels.values.insert(pixels.values.end(), row, row + ptrdiff_t{pixels.width} * 4);
  }
  return pixels;
}

void expectSize(const std::string& name, int width, int height) {
  int w = 0;
  int h = 0;
  EXPECT_TRUE(gdk_pixbuf_get_file_info((kFolder + name).c_str(), &w, &h)) << name;
  EXPECT_EQ(w, width) << name;
  EXPECT_EQ(h, height) << name;
}

std::string small(const std::string& name) {
  return "fileicon/80x80/zq_file_ic_" + name + ".png";
}
std::string large(const std::string& name) {
  return "fileicon/148x148/zq_file_full_ic_" + name + ".png";
}

const std::array kKinds{"ppt", "xls", "text", "img", "word", "pdf",     "html",
                        "vcf", "hwp", "date", "etc", "zip",  "unknown", "music"};
const std::array kVideoLayers{"video_play", "video_bg", "video_ef"};

std::vector<std::string> frames(const std::string& prefix) {
  std::vector<std::string> names;
  names.reserve(7);
  for (int frame = 0; frame < 7; ++frame) {
    names.push_back("zq_ic_download_progress/" + prefix + "0" + std::to_string(frame) + ".png");
  }
  return names;
}

const auto kSmallFrames = frames("31/zq_ic_download_process");
const auto kLargeFrames = frames("55/zq_ic_download_process_02_");

/// What the applications tint.
std::vector<std::string> tinted() {
  std::vector<std::string> names{"zq_caller_id_default_group.png",
                                 "contacts_caller_id_default_02.png",
                                 "contacts_caller_id_default_masking_02.png"};
  for (const char* layer : kVideoLayers) {
    names.push_back(small(layer));
    names.push_back(large(layer));
  }
  return names;
}

TEST(Artwork, HasEveryKindInBothSizes) {
  for (const char* kind : kKinds) {
    expectSize(small(kind), 80, 80);
    expectSize(large(kind), 148, 148);
  }
}

TEST(Artwork, HasTheSizesThatTheCellsExpect) {
  expectSize("zq_file_full_ic_shadow.png", 148, 24);
  expectSize("zq_ic_downloaded_02.png", 31, 31);
  expectSize("zq_ic_downloaded.png", 55, 55);
  for (const std::string& name : kSmallFrames) expectSize(name, 31, 31);
  for (const std::string& name : kLargeFrames) expectSize(name, 55, 55);
  expectSize("zq_caller_id_default_group.png", 74, 74);
  expectSize("contacts_caller_id_default_02.png", 74, 74);
  expectSize("contacts_caller_id_default_masking_02.png", 74, 74);
}

TEST(Artwork, LayersOfAPlayButtonFitOnEachOther) {
  for (const char* layer : kVideoLayers) {
    expectSize(small(layer), 60, 60);
    expectSize(large(layer), 148, 148);
  }
}

TEST(Artwork, HoldsNothingThatNobodyOpens) {
  int count = 0;
  for (const auto& entry : std::filesystem::recursive_directory_iterator(kFolder)) {
    count += entry.is_regular_file();
  }
  EXPECT_EQ(count, 54);
}

TEST(Artwork, LooksDifferentForEveryKind) {
  std::set<std::vector<guchar>> seen;
  for (const char* kind : kKinds) {
    EXPECT_TRUE(seen.insert(pixelsOf(small(kind)).values).second) << kind;
  }
}

TEST(Artwork, MovesInEveryFrameOfADownload) {
  for (const auto& names : {kSmallFrames, kLargeFrames}) {
    std::set<std::vector<guchar>> seen;
    for (const std::string& name : names) {
      EXPECT_TRUE(seen.insert(pixelsOf(name).values).second) << name;
    }
  }
}

// A tint multiplies: only white takes on exactly the colour of the tint.
TEST(Artwork, IsWhiteWhereItIsTinted) {
  for (const std::string& name : tinted()) {
    const Pixels pixels = pixelsOf(name);
    for (size_t at = 0; at < pixels.values.size(); at += 4) {
      if (pixels.values[at + 3] < 8) continue;  // rounding of what is nearly invisible
      const int darkest =
          std::min({pixels.values[at], pixels.values[at + 1], pixels.values[at + 2]});
      ASSERT_GE(darkest, 250) << name << " at " << at / 4;
    }
  }
}

TEST(Artwork, MasksTheCornersOfAPhotoOnly) {
  const Pixels mask = pixelsOf("contacts_caller_id_default_masking_02.png");
  ASSERT_EQ(mask.width, 74);
  EXPECT_EQ(mask.alphaAt(0, 0), 0);
  EXPECT_EQ(mask.alphaAt(73, 73), 0);
  EXPECT_EQ(mask.alphaAt(37, 37), 255);
  EXPECT_EQ(mask.alphaAt(37, 2), 255);
}

}  // namespace
