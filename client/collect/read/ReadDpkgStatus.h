#pragma once

#include <string_view>
#include <vector>

#include "client/collect/read/TFacts.h"
#include "client/collect/read/TReadFaults.h"

namespace NORVZEL20 {

/// The packages of dpkg's list (var/lib/dpkg/status) as KALMO_Package. Packages with nothing left on the system are left out.
std::vector<TFacts> ReadDpkgStatus(std::string_view text, TReadFaults& faults);

}  // namespace NORVZEL20
