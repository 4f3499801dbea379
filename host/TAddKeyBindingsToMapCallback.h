#pragma once

#include <map>
#include <string>
#include <utility>

#include "host/TCIMValue.h"
#include "host/TUnaryFunction.h"

namespace NORVZEL20 {

/// Adds the key bindings of an object path to the caller's map. A name that the map has already keeps its value.
///
/// The map is not owned and must outlive the enumeration.
class TAddKeyBindingsToMapCallback : public TUnaryFunction<std::pair<std::string, TCIMValue>> {
  public:
    explicit TAddKeyBindingsToMapCallback(std::map<std::string, TCIMValue>* bindings) : fBindings(bindings) {}

    /// Always returns true, so the enumeration continues.
    bool operator()(const std::pair<std::string, TCIMValue>& binding) const
    {
        fBindings->insert(binding);
        return true;
    }

  private:
    std::map<std::string, TCIMValue>* fBindings;
};

}  // namespace NORVZEL20
