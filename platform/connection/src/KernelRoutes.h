#pragma once

#include <net_connection.h>

#include <string>

/// The type of the interface that the default route with the lowest metric leaves by. `root` stands
/// in front of /proc and /sys.
connection_type_e typeFromKernel(const std::string& root);
