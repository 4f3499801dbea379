#pragma once

#include <string_view>
#include <vector>

#include "client/collect/read/TFacts.h"
#include "client/collect/read/TReadFaults.h"

namespace NORVZEL20 {

/// The users of etc/passwd as KALMO_User. The field of the password is passed over.
std::vector<TFacts> ReadUsers(std::string_view text, TReadFaults& faults);

/// The groups of etc/group as KALMO_Group. The field of the password is passed over.
std::vector<TFacts> ReadGroups(std::string_view text, TReadFaults& faults);

}  // namespace NORVZEL20
