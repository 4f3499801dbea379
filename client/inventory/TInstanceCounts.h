#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

/// How many instances the classes of the reference have, in all inventories together.
///
/// Only instances that came from inventories count, not those that the client made (see TSchemaNote).
/// Cost: one look-up for each class of the reference in each inventory, however often counts are asked for afterwards.
class TInstanceCounts {
  public:
    /// The first inventory is the reference. One that does not declare a class has none of its instances.
    TInstanceCounts(const std::vector<TInventory>& inventories, const std::vector<TSchemaNote>& notes);

    /// The instances of the class itself; 0 if the reference does not declare it.
    std::size_t OfClass(const std::string& className) const;
    /// Those of the class and of the classes that the reference declares below it; for the root class, all.
    std::size_t OfTree(const std::string& className) const;

  private:
    struct TCounts {
        std::size_t own = 0;
        std::size_t tree = 0;
    };

    TNameMap<TCounts> fCounts;
};

}  // namespace NORVZEL20
