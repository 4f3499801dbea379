#pragma once

#include <string>
#include <vector>

#include "client/collect/ISystemCalls.h"
#include "client/collect/TCollectionOptions.h"
#include "client/collect/TSystemRoot.h"
#include "embedded/cimxml/TCimXmlWriter.h"

namespace NORVZEL20 {

/// The kinds of things that can be collected, in the order in which they are.
std::vector<std::string> CollectedKinds();

/// Writes the inventory of a system as CIM-XML. Returns a line about each kind with something left out.
/// Errors: what the sink throws, TZELException of TInventoryWriter::Add, std::bad_alloc.
std::vector<std::string> CollectInventory(const TSystemRoot& root, ISystemCalls& calls, const TCollectionOptions& options,
                                          const TCimXmlWriter::TSink& sink);

}  // namespace NORVZEL20
