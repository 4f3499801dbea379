#pragma once

#include <string>
#include <vector>

#include "client/collect/TCollection.h"
#include "client/collect/read/TRpmPackage.h"

namespace NORVZEL20 {

/// The packages of rpm's database, the earliest installed first; none if there is no database. What cannot be read is left out of
/// the collection. Nothing is written, no lock is taken.
std::vector<TRpmPackage> ReadRpmDatabase(TCollection& collection);

}  // namespace NORVZEL20
