#include "ByteRange.h"

#include <gtest/gtest.h>

namespace service {
namespace {

struct Case {
  const char* header;
  std::int64_t size;
  ByteRange::Kind kind;
  std::int64_t first;
  std::int64_t length;
};

constexpr auto kWhole = ByteRange::Kind::Whole;
constexpr auto kPart = ByteRange::Kind::Part;
constexpr auto kNone = ByteRange::Kind::Unsatisfiable;

TEST(ByteRange, IsReadFromEveryFormOfTheHeader) {
  const Case cases[] = {
      {nullptr, 100, kWhole, 0, 0},
      {"bytes=0-9", 100, kPart, 0, 10},
      {"bytes=90-", 100, kPart, 90, 10},
      {"bytes=90-1000", 100, kPart, 90, 10},
      {"bytes=-10", 100, kPart, 90, 10},
      {"bytes=-1000", 100, kPart, 0, 100},
      {"bytes=99-99", 100, kPart, 99, 1},
      {"bytes=100-", 100, kNone, 0, 0},
      {"bytes=0-", 0, kNone, 0, 0},
      {"bytes=-0", 100, kNone, 0, 0},
      {"bytes=9-0", 100, kWhole, 0, 0},
      {"bytes=0-9,20-29", 100, kWhole, 0, 0},
      {"bytes=", 100, kWhole, 0, 0},
      {"bytes=a-b", 100, kWhole, 0, 0},
      {"bytes=1-2x", 100, kWhole, 0, 0},
      {"items=0-9", 100, kWhole, 0, 0},
      {"bytes=99999999999999999999-", 100, kWhole, 0, 0},
      {"bytes=--5", 100, kWhole, 0, 0},
  };
  for (const Case& expected : cases) {
    const ByteRange range = parseByteRange(expected.header, expected.size);
    const char* name = expected.header ? expected.header : "none";
    EXPECT_EQ(range.kind, expected.kind) << name;
    EXPECT_EQ(range.first, expected.first) << name;
    EXPECT_EQ(range.length, expected.length) << name;
  }
}

}  // namespace
}  // namespace service
