/// Whether the colours of each palette can be told apart by everybody.
#include <Edje.h>
#include <gtest/gtest.h>

#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <sstream>
#include <string>
#include <vector>

namespace {

constexpr double kText = 4.5;
constexpr double kSign = 3.0;
constexpr double kDisabled = 2.2;

struct Colour {
  int r = -1;
  int g = -1;
  int b = -1;
  int a = -1;
};

std::string item(const std::string& key) {
  char* value = edje_file_data_get(DEVICE_THEME, key.c_str());
  const std::string text = value ? value : "";
  free(value);
  return text;
}

double linear(int channel) {
  const double value = channel / 255.0;
  return value <= 0.04045 ? value / 12.92 : std::pow((value + 0.055) / 1.055, 2.4);
}

double luminance(const Colour& colour) {
  return 0.2126 * linear(colour.r) + 0.7152 * linear(colour.g) + 0.0722 * linear(colour.b);
}

double contrast(const Colour& one, const Colour& other) {
  const double a = luminance(one) + 0.05;
  const double b = luminance(other) + 0.05;
  return a > b ? a / b : b / a;
}

class Palette : public testing::TestWithParam<const char*> {
 protected:
  Colour colour(const std::string& name) const {
    Colour result;
    const std::string text = item(std::string(GetParam()) + "/" + name);
    EXPECT_EQ(sscanf(text.c_str(), "%d %d %d %d", &result.r, &result.g, &result.b, &result.a), 4)
        << GetParam() << "/" << name;
    return result;
  }

  void expectContrast(const std::vector<const char*>& fronts, const std::vector<const char*>& backs,
                      double least) const {
    for (const char* front : fronts) {
      for (const char* back : backs)
        EXPECT_GE(contrast(colour(front), colour(back)), least) << front << " on " << back;
    }
  }
};

}  // namespace

TEST(Contrast, IsTwentyOneBetweenBlackAndWhite) {
  EXPECT_NEAR(contrast({0, 0, 0, 255}, {255, 255, 255, 255}), 21, 0.001);
  EXPECT_NEAR(contrast({119, 119, 119, 255}, {255, 255, 255, 255}), 4.48, 0.01);
}

TEST_P(Palette, HasLegibleTextOnEveryGround) {
  expectContrast({"look/text", "look/text-2"}, {"look/page", "look/surface", "look/tile"}, kText);
}

TEST_P(Palette, HasLegibleLabelsOnButtons) {
  expectContrast({"look/on-accent"}, {"look/accent", "look/accent-pressed"}, kText);
  expectContrast({"look/accent"}, {"look/page", "look/surface", "look/tile"}, kText);
  expectContrast({"look/accent-pressed"}, {"look/tile", "look/line"}, kText);
}

TEST_P(Palette, HasLegibleErrors) {
  expectContrast({"look/danger"}, {"look/page", "look/surface"}, kText);
}

TEST_P(Palette, HasSignsThatStandOut) {
  expectContrast({"look/accent", "look/text-2"}, {"look/page", "look/surface", "look/tile"}, kSign);
}

TEST_P(Palette, ShowsHowFarWorkHasCome) {
  expectContrast({"look/accent"}, {"look/line"}, kSign);
}

TEST_P(Palette, StillShowsWhatADisabledControlSays) {
  expectContrast({"look/text-off"}, {"look/fill-off", "look/surface"}, kDisabled);
}

TEST_P(Palette, HasOpaqueColoursAndADimmingScrim) {
  std::istringstream names(item("colours"));
  for (std::string name; names >> name;) {
    if (name == "look/scrim") {
      EXPECT_GT(colour(name).a, 80);
      EXPECT_LT(colour(name).a, 200);
    } else {
      EXPECT_EQ(colour(name).a, 255) << name;
    }
  }
}

INSTANTIATE_TEST_SUITE_P(Of, Palette, testing::Values("light", "dark"));
