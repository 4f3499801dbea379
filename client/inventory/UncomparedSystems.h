#pragma once

#include <cstddef>
#include <vector>

#include "client/inventory/TSchemaNote.h"

namespace NORVZEL20 {

/// The positions of the inventories whose instance of KALMO_OperatingSystem the client made, ascending.
std::vector<std::size_t> FindMadeSystems(const std::vector<TSchemaNote>& notes);

/// Whether made instances leave nothing of KALMO_OperatingSystem to compare among that many inventories: the reference's was made,
/// or those of all others. False if none was made.
///
/// A made instance says nothing about a system and is never compared. Otherwise the class is compared in every inventory whose own
/// instance is real.
bool IsNoSystemCompared(const std::vector<TSchemaNote>& notes, std::size_t inventories);

}  // namespace NORVZEL20
