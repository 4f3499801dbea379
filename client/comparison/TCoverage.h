#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/inventory/TSchemaNote.h"

namespace NORVZEL20 {

/// What a comparison looked at and what it did not, and why.
struct TCoverage {
    enum EState {
        kCompared,
        kExcludedByRules,      ///< the rules leave no property to compare
        kUnknownToReference,   ///< the reference does not declare the class
        kOperatingSystemMade,  ///< KALMO_OperatingSystem as the client made it
    };

    /// One class that has instances in at least one inventory. Counts are of this class alone, one for each inventory.
    struct TClass {
        std::string name;
        EState state = kCompared;
        std::vector<std::size_t> instances;
        std::vector<std::string> leftOut;       ///< properties not compared, ascending; empty where the state is not kCompared
        std::vector<std::string> excludedKeys;  ///< keys that do not count for identity, in the order of the rules
        std::vector<std::size_t> sharing;       ///< instances that share their key with an earlier one, because of excluded keys
    };

    std::vector<TClass> classes;     ///< in ascending order of their names
    std::size_t classesWithout = 0;  ///< classes without an instance in any inventory
    std::vector<TSchemaNote> notes;  ///< in the order in which it was done

    /// Whether every instance of every inventory was compared in every property.
    bool IsComplete() const;
    /// The same, but for the time of collection, which is never compared where the default is to include.
    bool IsCompleteButForTimes() const;
    /// The classes of that state.
    std::size_t CountClasses(EState state) const;
    /// The instances of the compared classes in one inventory.
    std::size_t CountCompared(std::size_t inventory) const;
    /// Instances that share a key, over all classes and inventories.
    std::size_t CountSharing() const;

  private:
    bool IsWholeClass(const TClass& cls, bool timesCount) const;
    bool IsComplete(bool timesCount) const;
};

}  // namespace NORVZEL20
