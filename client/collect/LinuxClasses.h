#pragma once

#include <string_view>

namespace NORVZEL20 {

/// The text of client/collect/LinuxClasses.mof: the classes of a collected inventory.
std::string_view LinuxClasses();

}  // namespace NORVZEL20
