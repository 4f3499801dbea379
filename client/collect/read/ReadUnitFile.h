#pragma once

#include <string_view>

#include "client/collect/read/TUnitFile.h"

namespace NORVZEL20 {

/// Adds what the file of a unit says to `unit`; a file that changes another (drop-in) comes after it. Lines that are none of a unit
/// are passed over, as systemd does.
void ReadUnitFile(std::string_view text, TUnitFile& unit);

}  // namespace NORVZEL20
