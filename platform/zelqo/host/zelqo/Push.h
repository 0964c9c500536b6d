/// What the sharing service tells a phone.
#pragma once

#include <zelqo/Share.h>

#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

namespace zelqo {

struct PushEvent {
  enum class Kind { Received, Recalled };
  Kind kind = Kind::Received;
  ReceivedShare share;  ///< of a recalled one only the token
};

struct Push {
  std::vector<PushEvent> events;
  std::int64_t cursor = 0;  ///< where the next poll goes on
};

/// Nothing when the text is not a push at all. Events that make no sense are logged and left out.
std::optional<Push> readPush(std::string_view json);

}  // namespace zelqo
