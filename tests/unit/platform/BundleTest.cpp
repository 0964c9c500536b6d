#include "TestPhone.h"

#include <bundle.h>

#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

namespace {

class Bundle : public testing::Test {
 protected:
  ~Bundle() override { bundle_free(_b); }

  std::vector<std::string> keys(bundle* b) {
    std::vector<std::string> keys;
    bundle_foreach(
        b,
        [](const char* key, const int, const bundle_keyval_t*, void* data) {
          static_cast<std::vector<std::string>*>(data)->push_back(key);
        },
        &keys);
    return keys;
  }

  std::vector<bundle_raw> encoded() {
    bundle_raw* raw = nullptr;
    int length = 0;
    EXPECT_EQ(bundle_encode(_b, &raw, &length), BUNDLE_ERROR_NONE);
    std::vector<bundle_raw> bytes(raw, raw + length);
    free(raw);
    return bytes;
  }

  void fill() {
    const char* texts[] = {"one", "", "three"};
    bundle_add_str(_b, "zebra", "1");
    bundle_add_str_array(_b, "list", texts, 3);
    bundle_add_str(_b, "apple", "");
  }

  bundle* _b = bundle_create();
};

}  // namespace

TEST_F(Bundle, KeepsTheOrderOfAddition) {
  fill();
  EXPECT_EQ(keys(_b), (std::vector<std::string>{"zebra", "list", "apple"}));
}

TEST_F(Bundle, KeepsTheFirstOfTwoValuesOfAKey) {
  bundle_add_str(_b, "key", "first");
  EXPECT_EQ(bundle_add_str(_b, "key", "second"), BUNDLE_ERROR_KEY_EXISTS);
  EXPECT_EQ(bundle_add_str_array(_b, "key", nullptr, 0), BUNDLE_ERROR_KEY_EXISTS);
  EXPECT_STREQ(bundle_get_val(_b, "key"), "first");
  EXPECT_EQ(bundle_get_count(_b), 1);
}

TEST_F(Bundle, HandsOutPointersThatStayWhileOthersComeAndGo) {
  const char* texts[] = {"a", "b"};
  bundle_add_str(_b, "gone", "x");
  bundle_add_str(_b, "key", "v");
  bundle_add_str_array(_b, "list", texts, 2);
  const char* text = bundle_get_val(_b, "key");
  int length = 0;
  const char** list = bundle_get_str_array(_b, "list", &length);
  bundle_del(_b, "gone");
  for (int i = 0; i < 1000; i++) bundle_add_str(_b, std::to_string(i).c_str(), "filler");
  EXPECT_EQ(bundle_get_val(_b, "key"), text);
  EXPECT_STREQ(text, "v");
  EXPECT_EQ(bundle_get_str_array(_b, "list", &length), list);
  EXPECT_STREQ(list[1], "b");
  EXPECT_EQ(length, 2);
}

TEST_F(Bundle, TellsTextsAndArraysApart) {
  fill();
  char* text = nullptr;
  int length = 7;
  EXPECT_EQ(bundle_get_type(_b, "zebra"), BUNDLE_TYPE_STR);
  EXPECT_EQ(bundle_get_type(_b, "list"), BUNDLE_TYPE_STR_ARRAY);
  EXPECT_EQ(bundle_get_type(_b, "none"), BUNDLE_TYPE_NONE);
  EXPECT_EQ(bundle_get_str(_b, "list", &text), BUNDLE_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(bundle_get_str(_b, "none", &text), BUNDLE_ERROR_KEY_NOT_AVAILABLE);
  EXPECT_EQ(text, nullptr);
  EXPECT_EQ(bundle_get_str_array(_b, "zebra", &length), nullptr);
  EXPECT_EQ(length, 0);
  EXPECT_EQ(get_last_result(), BUNDLE_ERROR_INVALID_PARAMETER);
}

TEST_F(Bundle, RefusesWhatItCannotStore) {
  const char* none = nullptr;
  const char* texts[] = {"a"};
  EXPECT_EQ(bundle_add_str(nullptr, "k", "v"), BUNDLE_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(bundle_add_str(_b, none, "v"), BUNDLE_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(bundle_add_str(_b, "", "v"), BUNDLE_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(bundle_add_str(_b, "k", none), BUNDLE_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(bundle_add_str_array(_b, "k", texts, -1), BUNDLE_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(bundle_add_str_array(_b, "k", nullptr, 1), BUNDLE_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(bundle_del(_b, "k"), BUNDLE_ERROR_KEY_NOT_AVAILABLE);
  EXPECT_EQ(bundle_free(nullptr), BUNDLE_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(bundle_get_count(_b), 0);
}

TEST_F(Bundle, TakesANullEntryAsAnEmptyText) {
  const char* texts[] = {"a", nullptr};
  bundle_add_str_array(_b, "k", texts, 2);
  EXPECT_STREQ(bundle_get_str_array(_b, "k", nullptr)[1], "");
}

TEST_F(Bundle, SharesNothingWithItsCopy) {
  fill();
  bundle* copy = bundle_dup(_b);
  bundle_del(_b, "list");
  bundle_del(_b, "zebra");
  EXPECT_EQ(keys(copy), (std::vector<std::string>{"zebra", "list", "apple"}));
  EXPECT_STREQ(bundle_get_val(copy, "zebra"), "1");
  EXPECT_STREQ(bundle_get_str_array(copy, "list", nullptr)[2], "three");
  bundle_free(copy);
}

TEST_F(Bundle, ComesBackFromItsBytesAsItWas) {
  fill();
  const auto bytes = encoded();
  bundle* back = bundle_decode(bytes.data(), static_cast<int>(bytes.size()));
  ASSERT_NE(back, nullptr);
  EXPECT_EQ(keys(back), keys(_b));
  int length = 0;
  const char** list = bundle_get_str_array(back, "list", &length);
  ASSERT_EQ(length, 3);
  EXPECT_STREQ(list[0], "one");
  EXPECT_STREQ(list[1], "");
  EXPECT_STREQ(bundle_get_val(back, "apple"), "");
  bundle_free(back);
}

TEST_F(Bundle, ComesBackEmptyFromTheBytesOfAnEmptyOne) {
  const auto bytes = encoded();
  bundle* back = bundle_decode(bytes.data(), static_cast<int>(bytes.size()));
  ASSERT_NE(back, nullptr);
  EXPECT_EQ(bundle_get_count(back), 0);
  bundle_free(back);
}

TEST_F(Bundle, IsNotMadeOfOtherBytes) {
  const bundle_raw garbage[] = "no bundle at all, just some text that is long enough";
  EXPECT_EQ(bundle_decode(nullptr, 10), nullptr);
  EXPECT_EQ(bundle_decode(garbage, 0), nullptr);
  EXPECT_EQ(bundle_decode(garbage, -1), nullptr);
  EXPECT_EQ(bundle_decode(garbage, sizeof garbage), nullptr);
}

// With a look through all entries for every new key this would go on for hours.
TEST_F(Bundle, OfAStrangerMayHaveVeryManyKeys) {
  constexpr int kKeys = 300000;
  GVariantBuilder entries;
  g_variant_builder_init(&entries, G_VARIANT_TYPE_VARDICT);
  for (int i = 0; i < kKeys; i++) {
    g_variant_builder_add(&entries, "{sv}", std::to_string(i).c_str(), g_variant_new_string(""));
  }
  GVariant* contents = g_variant_ref_sink(g_variant_builder_end(&entries));
  std::vector<bundle_raw> bytes(8 + g_variant_get_size(contents));
  memcpy(bytes.data(), "bundle1\n", 8);
  g_variant_store(contents, bytes.data() + 8);
  g_variant_unref(contents);

  bundle* back = bundle_decode(bytes.data(), static_cast<int>(bytes.size()));
  ASSERT_NE(back, nullptr);
  EXPECT_EQ(bundle_get_count(back), kKeys);
  bundle_free(back);
}

TEST_F(Bundle, SurvivesEveryCutAndEveryFlippedByteOfItsBytes) {
  fill();
  const auto bytes = encoded();
  const auto decodeAndUse = [](const std::vector<bundle_raw>& raw) {
    bundle* back = bundle_decode(raw.data(), static_cast<int>(raw.size()));
    if (!back) return;
    bundle_foreach(
        back,
        [](const char* key, const int, const bundle_keyval_t*, void*) {
          EXPECT_NE(*key, '\0');
          EXPECT_TRUE(g_utf8_validate(key, -1, nullptr));
        },
        nullptr);
    bundle_free(back);
  };
  for (size_t length = 0; length < bytes.size(); length++) {
    decodeAndUse({bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(length)});
  }
  for (size_t i = 0; i < bytes.size(); i++) {
    for (const int flip : {0x01, 0x80, 0xff}) {
      auto broken = bytes;
      broken[i] ^= static_cast<bundle_raw>(flip);
      decodeAndUse(broken);
    }
  }
}
