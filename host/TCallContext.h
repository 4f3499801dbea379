#pragma once

#include <map>
#include <string>

namespace NORVZEL20 {

class TCIMValue;

/// The call context: named values that accompany every call on a host interface.
///
/// It is the last argument of every operation and is passed by value: a callee may change its copy. Keys are compared byte for
/// byte. Copying an empty context allocates nothing.
///
/// The delta namespace reads one key, "nsIndex". Its value must convert to `unsigned short`. It is the position, counted from 0, of
/// the compared namespace that answers requests for classes and qualifiers.
using TCallContext = std::map<std::string, TCIMValue>;

}  // namespace NORVZEL20
