#pragma once

#include <net_connection.h>

#include <optional>

/// The type of the primary connection as NetworkManager has it; nothing when it does not run or
/// does not answer.
std::optional<connection_type_e> typeFromNetworkManager();
