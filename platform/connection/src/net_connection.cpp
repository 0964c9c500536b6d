#include <base/Fault.h>
#include <net_connection.h>

#include "KernelRoutes.h"
#include "NetworkManager.h"

namespace {

/// Nothing to keep: every question is asked anew, and the bus is the process's own.
struct Connection {};

}  // namespace

int connection_create(connection_h* connection) {
  if (base::strikes(__func__)) return CONNECTION_ERROR_OUT_OF_MEMORY;
  if (!connection) return CONNECTION_ERROR_INVALID_PARAMETER;
  *connection = new Connection;
  return CONNECTION_ERROR_NONE;
}

int connection_destroy(connection_h connection) {
  if (!connection) return CONNECTION_ERROR_INVALID_PARAMETER;
  delete static_cast<Connection*>(connection);
  return CONNECTION_ERROR_NONE;
}

int connection_get_type(connection_h connection, connection_type_e* type) {
  if (base::strikes(__func__)) return CONNECTION_ERROR_OPERATION_FAILED;
  if (!connection || !type) return CONNECTION_ERROR_INVALID_PARAMETER;
  const auto managed = typeFromNetworkManager();
  *type = managed ? *managed : typeFromKernel("");
  return CONNECTION_ERROR_NONE;
}
