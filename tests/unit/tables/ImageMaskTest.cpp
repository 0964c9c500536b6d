#include "ImageMask.h"

#include <efl_assist.h>
#include <gtest/gtest.h>

namespace {

Pixels plain(int width, int height, std::vector<uint8_t> pixel) {
  Pixels pixels{width, height, {}};
  for (int i = 0; i < width * height; ++i) {
    pixels.rgba.insert(pixels.rgba.end(), pixel.begin(), pixel.end());
  }
  return pixels;
}

}  // namespace

TEST(ImageMask, KeepsWhatAnOpaqueMaskCovers) {
  const auto result = maskPixels(plain(2, 1, {10, 20, 30, 255}), plain(2, 1, {0, 0, 0, 255}), 0, 0);
  EXPECT_EQ(result, (std::vector<uint32_t>{0xff0a141e, 0xff0a141e}));
}

TEST(ImageMask, HidesWhatATransparentMaskCovers) {
  const auto result = maskPixels(plain(1, 1, {10, 20, 30, 255}), plain(1, 1, {9, 9, 9, 0}), 0, 0);
  EXPECT_EQ(result, (std::vector<uint32_t>{0}));
}

TEST(ImageMask, PremultipliesColoursWithImageAndMaskAlpha) {
  const auto result =
      maskPixels(plain(1, 1, {255, 128, 0, 128}), plain(1, 1, {0, 0, 0, 128}), 0, 0);
  EXPECT_EQ(result, (std::vector<uint32_t>{0x40402000}));
}

TEST(ImageMask, ShowsNothingBesideTheMask) {
  const auto result =
      maskPixels(plain(3, 1, {255, 255, 255, 255}), plain(1, 1, {0, 0, 0, 255}), 1, 0);
  EXPECT_EQ(result, (std::vector<uint32_t>{0, 0xffffffff, 0}));
}

TEST(ImageMask, TakesOffsetsFarOutside) {
  const auto image = plain(1, 1, {1, 1, 1, 255});
  EXPECT_EQ(maskPixels(image, image, 2000000000, -2000000000), (std::vector<uint32_t>{0}));
}

TEST(ImageMask, IsNullForFilesThatAreNoPictures) {
  EXPECT_EQ(ea_image_effect_mask("/etc/hostname", "/etc/hostname", 74, 74, 0, 0), nullptr);
  EXPECT_EQ(ea_image_effect_mask("/nowhere.png", nullptr, 74, 74, 0, 0), nullptr);
  EXPECT_EQ(ea_image_effect_mask(nullptr, nullptr, 0, -1, 0, 0), nullptr);
}
