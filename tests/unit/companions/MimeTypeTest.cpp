#include <gtest/gtest.h>
#include <mime_type.h>

#include <cstdlib>
#include <string>

namespace {

std::string typeOf(const char* extension) {
  char* type = nullptr;
  if (mime_type_get_mime_type(extension, &type) != MIME_TYPE_ERROR_NONE) return "error";
  std::string result = type;
  std::free(type);
  return result;
}

}  // namespace

TEST(MimeType, KnowsTheExtensionsOfAPhone) {
  const struct {
    const char* extension;
    const char* type;
  } cases[] = {
      {"jpg", "image/jpeg"},
      {"png", "image/png"},
      {"gif", "image/gif"},
      {"mp4", "video/mp4"},
      {"mp3", "audio/mpeg"},
      {"pdf", "application/pdf"},
      {"ppt", "application/vnd.ms-powerpoint"},
      {"docx", "application/vnd.openxmlformats-officedocument.wordprocessingml.document"},
      {"xlsx", "application/vnd.openxmlformats-officedocument.spreadsheetml.sheet"},
      {"hwp", "application/x-hwp"},
      {"zip", "application/zip"},
      {"apk", "application/vnd.android.package-archive"},
      {"vcf", "text/vcard"},
      {"ics", "text/calendar"},
      {"html", "text/html"},
      {"txt", "text/plain"},
      {"ts", "video/mp2t"},
      {"3ga", "audio/3gpp"},
  };
  for (const auto& c : cases) EXPECT_EQ(typeOf(c.extension), c.type) << c.extension;
}

TEST(MimeType, IgnoresCase) {
  EXPECT_EQ(typeOf("JPG"), "image/jpeg");
  EXPECT_EQ(typeOf("Ts"), "video/mp2t");
}

TEST(MimeType, CallsWhatItDoesNotKnowAStreamOfBytes) {
  for (const char* extension :
       {"", "weird", "hwpx", "gul", "a/b.jpg", "\xFF\xFE", "%s%n", "j pg"}) {
    EXPECT_EQ(typeOf(extension), "application/octet-stream") << extension;
  }
  EXPECT_EQ(typeOf(std::string(100000, 'x').c_str()), "application/octet-stream");
}

TEST(MimeType, RefusesMissingArguments) {
  char* type = nullptr;
  EXPECT_EQ(mime_type_get_mime_type(nullptr, &type), MIME_TYPE_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(mime_type_get_mime_type("jpg", nullptr), MIME_TYPE_ERROR_INVALID_PARAMETER);
}
