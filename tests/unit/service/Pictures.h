/// Pictures to send, and what pictures that came back are.
#pragma once

#include <string>

/// "png" or "jpeg" bytes of a picture whose upper left quarter is red and the rest blue.
std::string encodedPicture(int width, int height, const char* format);
/// A PNG that nothing is to be seen of.
std::string clearPicture(int width, int height);
/// A JPEG that is to be turned by a quarter to the right before it is shown.
std::string turnedJpeg(int width, int height);
/// A PNG of correct form whose header claims any size.
std::string pngClaiming(unsigned width, unsigned height);

struct Decoded {
  int width = 0;  ///< 0 for what is no picture
  int height = 0;
  bool isRedUpperLeft = false;
  bool isRedUpperRight = false;
  bool isWhiteUpperLeft = false;
};
Decoded decode(const std::string& bytes);
