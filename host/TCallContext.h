#pragma once

#include <map>
#include <string>

namespace NORVZEL20 {

class TCIMValue;

/// The call context: named values that accompany every call on a host interface.
///
/// It is the last argument of every operation and travels by value, so that a callee may change its copy
/// without the caller noticing. Keys are compared byte for byte. Copying an empty context allocates nothing.
///
/// The delta namespace reads one key, "nsIndex": any value that converts to `unsigned short`; it selects, counted
/// from 0, the compared namespace that class and qualifier requests are routed to.
using TCallContext = std::map<std::string, TCIMValue>;

}  // namespace NORVZEL20
