/// Runs a program and keeps what it says.
#pragma once

#include <string>
#include <vector>

namespace phone {

struct Output {
  int status = -1;  ///< exit status; negative when a signal ended it
  std::string out;
  std::string err;
};

using Words = std::vector<std::string>;

/// `environment`: NAME=VALUE texts in addition to this process's own.
Output run(const Words& words, const Words& environment = {});

}  // namespace phone
