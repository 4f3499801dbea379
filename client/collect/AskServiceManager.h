#pragma once

#include <optional>
#include <string>
#include <vector>

#include "client/collect/TUnitState.h"

namespace NORVZEL20 {

/// The units that systemd has loaded, those without a file that was found left out. Nothing, with the reason in `trouble`, if
/// systemd cannot be asked or does not answer within some seconds, or if this program was built without the library for it.
///
/// `address` is that of the bus, as D-Bus writes addresses; empty for the system's own.
std::optional<std::vector<TUnitState>> AskServiceManager(const std::string& address, std::string& trouble);

}  // namespace NORVZEL20
