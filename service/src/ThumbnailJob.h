/// What the thumbnail program is asked to do.
#pragma once

#include <string>

namespace service {

struct ThumbnailJob {
  bool video = false;
  std::string input;
  std::string thumb;
  std::string mid;
  std::string big;
};

}  // namespace service
