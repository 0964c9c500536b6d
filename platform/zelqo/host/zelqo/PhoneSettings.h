/// What the phone knows of itself as a subscriber.
#pragma once

#include <string>

namespace zelqo {

/// Address of the sharing service without a slash at the end; empty when the phone has none.
std::string serviceUrl();
/// The phone's own number; empty when it has none.
std::string ownNumber();

}  // namespace zelqo
