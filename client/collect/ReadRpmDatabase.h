#pragma once

#include <vector>

#include "client/collect/TCollection.h"
#include "client/collect/read/TRpmPackage.h"

namespace NORVZEL20 {

/// The packages of rpm's database, the earliest installed first; none if there is no database. What cannot be read is left out of
/// the collection. The database is not changed; a lock is taken only if a log of changes is beside it.
std::vector<TRpmPackage> ReadRpmDatabase(TCollection& collection);

}  // namespace NORVZEL20
