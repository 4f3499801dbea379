#pragma once

#include <string>

namespace NORVZEL20 {

/// What the service manager says of a unit that it has loaded.
struct TUnitState {
    std::string name;
    std::string description;
    std::string activeState;
    std::string subState;
};

}  // namespace NORVZEL20
