#pragma once

#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "client/collect/read/TFacts.h"
#include "client/collect/read/TReadFaults.h"

namespace NORVZEL20 {

/// Ranges of numbers, "100000:65536", by the name or number of the user.
using TSubordinateNumbers = std::map<std::string, std::vector<std::string>>;

/// The numbers of etc/subuid or etc/subgid, which users may give to what they run.
TSubordinateNumbers ReadSubordinateNumbers(std::string_view text, TReadFaults& faults);

/// The users of etc/passwd as KALMO_User. The field of the password is passed over.
std::vector<TFacts> ReadUsers(std::string_view text, TReadFaults& faults);

/// The groups of etc/group as KALMO_Group. The field of the password is passed over.
std::vector<TFacts> ReadGroups(std::string_view text, TReadFaults& faults);

}  // namespace NORVZEL20
