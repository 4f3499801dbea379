#pragma once

#include <string>
#include <vector>

#include "client/wbem/TWbemServer.h"

namespace NORVZEL20 {

/// The namespaces that a server says it has, in ascending order; empty if it does not say. It is asked for instances of
/// CIM_Namespace in its interop namespace, then for those of __Namespace, which lead from root to all others.
/// Errors: TWbemFault if no request can succeed; std::bad_alloc.
std::vector<std::string> FindNamespaces(TWbemServer& server);

}  // namespace NORVZEL20
