#pragma once

#include <map>
#include <string>
#include <utility>

#include "host/TCIMValue.h"
#include "host/TUnaryFunction.h"

namespace NORVZEL20 {

/// Puts the key bindings of an object path into the caller's map; a name that is there already keeps its value.
///
/// The map is not owned and must outlive the enumeration.
class TAddKeyBindingsToMapCallback : public TUnaryFunction<std::pair<std::string, TCIMValue>> {
  public:
    explicit TAddKeyBindingsToMapCallback(std::map<std::string, TCIMValue>* bindings) : fBindings(bindings) {}

    /// Always true: the enumeration goes on.
    bool operator()(const std::pair<std::string, TCIMValue>& binding) const
    {
        fBindings->insert(binding);
        return true;
    }

  private:
    std::map<std::string, TCIMValue>* fBindings;
};

}  // namespace NORVZEL20
