#include "ViewerTest.h"
#include "ZQVCommon.h"

namespace {

class SizeText : public ViewerTest {
 protected:
  static std::string of(uint64_t size, float* value) {
    return taken(ZQViewerCommon::getInstance().zquiCommonConvertFileSizeUnit(size, value));
  }
};

struct Case {
  uint64_t size;
  float value;
  const char* unit;
};

TEST_F(SizeText, UsesTheLargestUnitThatGivesAtLeastOne) {
  const Case cases[] = {
      {0, 0.0f, "B"},
      {1, 1.0f, "B"},
      {1023, 1023.0f, "B"},
      {1024, 1.0f, "KB"},
      {1536, 1.5f, "KB"},
      {1048575, 1023.999f, "KB"},
      {1048576, 1.0f, "MB"},
      {3ULL << 30, 3072.0f, "MB"},
      {5ULL << 30, 5120.0f, "MB"},
  };
  for (const Case& one : cases) {
    float value = -1;
    EXPECT_EQ(of(one.size, &value), one.unit) << one.size;
    EXPECT_NEAR(value, one.value, 0.001) << one.size;
  }
}

TEST_F(SizeText, LosesThePrecisionOfAFloatForLargeSizes) {
  float value = 0;
  EXPECT_EQ(of((1ULL << 40) + 12345, &value), "MB");
  EXPECT_EQ(value, 1048576.0f);
}

TEST_F(SizeText, SurvivesTheLargestSize) {
  float value = 0;
  EXPECT_EQ(of(UINT64_MAX, &value), "MB");
  EXPECT_EQ(value, 0x1p44f);
}

TEST_F(SizeText, NeedsSomewhereToPutTheValue) {
  EXPECT_EQ(of(1, nullptr), "(null)");
  EXPECT_EQ(errors(), Errors({"size is NULL"}));
}

}  // namespace
