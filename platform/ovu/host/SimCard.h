#pragma once

#include <string>

namespace ovu {

/// The identity on the SIM card of the first modem that has one, asked of ModemManager on the
/// system bus; empty without a modem. Waits a second at the most.
std::string simCardImsi();

}  // namespace ovu
