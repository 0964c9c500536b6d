/// How much there is to download, as the pages say it.
#pragma once

#include <stdint.h>

#include <string>

#include "ZQVOwned.h"

/// An amount of bytes as a number and its unit, "B", "KB" or "MB".
struct ZQVSizeText {
  explicit ZQVSizeText(uint64_t bytes);

  char number[10];
  ZQVOwnedText unit;
};

/// "1 file (0.50 MB)", in the language of now.
std::string zqvFilesAndSize(int count, uint64_t bytes);
