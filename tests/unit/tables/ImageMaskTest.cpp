#include "ImageMask.h"

#include <efl_assist.h>
#include <gtest/gtest.h>

#include <vector>

namespace {

struct Plain {
  Plain(int width, int height, std::vector<uint8_t> pixel) : width(width), height(height) {
    for (int i = 0; i < width * height; ++i) bytes.insert(bytes.end(), pixel.begin(), pixel.end());
    channels = static_cast<int>(pixel.size());
  }
  theme::Pixels pixels() const {
    return {bytes.data(), {width, height}, static_cast<size_t>(width) * channels, channels};
  }

  int width;
  int height;
  int channels;
  std::vector<uint8_t> bytes;
};

std::vector<uint32_t> masked(const Plain& picture, const Plain& mask, int x, int y) {
  std::vector<uint32_t> result(static_cast<size_t>(picture.width) * picture.height);
  theme::maskPixels(picture.pixels(), mask.pixels(), x, y, result.data());
  return result;
}

}  // namespace

TEST(ImageMask, KeepsWhatAnOpaqueMaskCovers) {
  const auto result = masked(Plain(2, 1, {10, 20, 30, 255}), Plain(2, 1, {0, 0, 0, 255}), 0, 0);
  EXPECT_EQ(result, (std::vector<uint32_t>{0xff0a141e, 0xff0a141e}));
}

TEST(ImageMask, HidesWhatATransparentMaskCovers) {
  const auto result = masked(Plain(1, 1, {10, 20, 30, 255}), Plain(1, 1, {9, 9, 9, 0}), 0, 0);
  EXPECT_EQ(result, (std::vector<uint32_t>{0}));
}

TEST(ImageMask, PremultipliesColoursWithImageAndMaskAlpha) {
  const auto result = masked(Plain(1, 1, {255, 128, 0, 128}), Plain(1, 1, {0, 0, 0, 128}), 0, 0);
  EXPECT_EQ(result, (std::vector<uint32_t>{0x40402000}));
}

TEST(ImageMask, ShowsNothingBesideTheMask) {
  const auto result = masked(Plain(3, 1, {255, 255, 255, 255}), Plain(1, 1, {0, 0, 0, 255}), 1, 0);
  EXPECT_EQ(result, (std::vector<uint32_t>{0, 0xffffffff, 0}));
}

TEST(ImageMask, TakesAPictureWithoutOpacityAsOpaque) {
  const auto result = masked(Plain(1, 1, {255, 0, 255}), Plain(1, 1, {0, 0, 0, 255}), 0, 0);
  EXPECT_EQ(result, (std::vector<uint32_t>{0xffff00ff}));
}

TEST(ImageMask, RefusesOffsetsFarOutside) {
  EXPECT_EQ(ea_image_effect_mask("/a.png", "/a.png", 74, 74, 2000000000, -2000000000), nullptr);
}

TEST(ImageMask, IsNullForFilesThatAreNoPictures) {
  EXPECT_EQ(ea_image_effect_mask("/etc/hostname", "/etc/hostname", 74, 74, 0, 0), nullptr);
  EXPECT_EQ(ea_image_effect_mask("/nowhere.png", nullptr, 74, 74, 0, 0), nullptr);
  EXPECT_EQ(ea_image_effect_mask(nullptr, nullptr, 0, -1, 0, 0), nullptr);
}
