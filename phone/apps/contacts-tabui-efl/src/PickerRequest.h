#pragma once

#include <app_control.h>

#include <cstddef>
#include <cstdint>

namespace picker {

/// What the asking application wants sent, and to how many at the most.
struct PickerRequest {
  std::int64_t shareId = 0;  ///< request id of the share to send again, 0 when it names none
  std::size_t maxContacts = 0;
  bool isSingle = false;
};

PickerRequest readRequest(app_control_h request);

}  // namespace picker
