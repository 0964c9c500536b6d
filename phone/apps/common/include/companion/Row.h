#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace companion {

/// One row of a list. All texts are plain, not markup.
struct Row {
  struct Action {
    std::string label;
    std::function<void()> run;
  };

  std::string title;
  std::string detail;
  std::string icon;                ///< path of a picture, empty for none
  std::optional<double> progress;  ///< 0 to 1
  std::optional<bool> checked;     ///< a check box at the end
  std::vector<Action> actions;     ///< buttons under the texts
};

using RowKey = std::int64_t;

}  // namespace companion
