#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/inventory/TSchemaNote.h"

namespace NORVZEL20 {

/// What a comparison looked at, what it did not, and why.
struct TCoverage {
    enum EState {
        kCompared,
        kExcludedByRules,      ///< the rules leave no property to compare
        kUnknownToReference,   ///< the reference does not declare the class
        kOperatingSystemMade,  ///< the rules exclude KALMO_OperatingSystem because the client made an instance of it
    };

    /// One class that has instances in at least one inventory. Counts are of this class alone, one for each inventory.
    struct TClass {
        std::string name;
        EState state = kCompared;
        std::vector<std::size_t> instances;
        std::vector<std::string> leftOut;       ///< properties not compared, ascending; empty unless the state is kCompared
        std::vector<std::string> excludedKeys;  ///< keys that do not identify instances, in the order of the rules
        std::vector<std::size_t> sharing;       ///< instances that have the key of an earlier one, because keys are excluded
    };

    std::vector<TClass> classes;     ///< in ascending order of their names
    std::size_t classesWithout = 0;  ///< classes without an instance in any inventory
    std::vector<TSchemaNote> notes;  ///< what was done to make the inventories comparable, in that order

    /// Whether every instance of every inventory was compared in every property.
    bool IsComplete() const;
    /// The same, times of collection aside: a class whose default is to include is compared without them.
    bool IsCompleteButForTimes() const;
    /// How many classes have that state.
    std::size_t CountClasses(EState state) const;
    /// How many instances of compared classes one inventory has.
    std::size_t CountCompared(std::size_t inventory) const;
    /// How many instances share a key, over all classes and inventories.
    std::size_t CountSharing() const;

  private:
    bool IsWholeClass(const TClass& cls, bool timesCount) const;
    bool IsComplete(bool timesCount) const;
};

}  // namespace NORVZEL20
