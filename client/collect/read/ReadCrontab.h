#pragma once

#include <string_view>
#include <vector>

#include "client/collect/read/TJob.h"
#include "client/collect/read/TReadFaults.h"

namespace NORVZEL20 {

/// The jobs of a table of cron. `hasUsers` says whether each line names its user, as in etc/crontab, or the table is that of one
/// user.
std::vector<TJob> ReadCrontab(std::string_view text, bool hasUsers, TReadFaults& faults);

/// The jobs of etc/anacrontab.
std::vector<TJob> ReadAnacrontab(std::string_view text, TReadFaults& faults);

}  // namespace NORVZEL20
