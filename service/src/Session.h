/// Who asks.
#pragma once

#include <libsoup/soup.h>

#include <optional>
#include <string>

#include "Catalog.h"

namespace service {

/// The number whose key the request carries; otherwise answers 401 and gives nothing.
std::optional<std::string> authenticate(SoupServerMessage* message, Catalog& catalog);

}  // namespace service
