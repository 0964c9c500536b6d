// Reading the screen and touching it.

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

#include "Phone.h"

using phone::Output;
using phone::Phone;
using phone::thePhone;

TEST(PhoneScreenshot, IsAPictureOfTheWholeScreen) {
  Phone& phone = thePhone();
  const std::string file = phone.folder() + "/screen.png";
  phone({"screenshot", file});
  std::ifstream picture(file, std::ios::binary);
  unsigned char head[24] = {};
  picture.read(reinterpret_cast<char*>(head), sizeof head);
  EXPECT_EQ(std::string(head + 1, head + 4), "PNG");
  EXPECT_EQ(head[18] << 8 | head[19], 720);
  EXPECT_EQ(head[22] << 8 | head[23], 1280);
}

TEST(PhoneScreenshot, LeavesNoFileWhenThereIsNoPhone) {
  const std::string folder = thePhone().folder();
  const std::string file = folder + "/none.png";
  EXPECT_NE(thePhone().command({"screenshot", file, "--state", folder + "-none"}).status, 0);
  EXPECT_FALSE(std::filesystem::exists(file));
}

TEST(PhoneTree, IsEmptyWhileNoApplicationIsOnTheScreen) {
  EXPECT_EQ(thePhone()({"tree"}), "");
}

TEST(PhoneTap, SaysThatNothingHasThatName) {
  const Output output = thePhone().command({"tap", "Nowhere"});
  EXPECT_EQ(output.status, 1);
  EXPECT_NE(output.err.find("'Nowhere'"), std::string::npos) << output.err;
}

TEST(PhoneKey, SaysThatThereIsNoSuchKey) {
  const Output output = thePhone().command({"key", "NoSuchKey"});
  EXPECT_EQ(output.status, 1);
  EXPECT_NE(output.err.find("NoSuchKey"), std::string::npos) << output.err;
}
