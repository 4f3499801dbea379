#pragma once

#include <cstddef>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "client/comparison/TNameHint.h"
#include "client/inventory/NotCollected.h"
#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

/// What a comparison looked at, what it did not, and why.
struct TCoverage {
    enum EState {
        kCompared,
        kExcludedByRules,      ///< the rules reach the class, but leave no property to compare
        kReachedByNoElement,   ///< no element of the rules is for the class or one above it
        kLeftOutByOptions,     ///< the rules compare the class, but options leave no property of it
        kNothingToCompare,     ///< the class has no property, or only the time of collection
        kUnknownToReference,   ///< the reference does not declare the class
        kOperatingSystemMade,  ///< the client made the reference's instance of KALMO_OperatingSystem, or those of all others
    };

    /// Why a property of a compared class is not compared.
    enum class EReason {
        kUsedAsKey,         ///< it identifies instances, and the rules do not have it compared as a property
        kNotDeclared,       ///< the reference does not declare it
        kTimeOfCollection,  ///< the plug-in leaves it out if the default is to include
        kLeftOutByRules,
        kLeftOutByOptions  ///< the rules have it compared, but options leave it out
    };

    /// A property that is not compared.
    struct TLeftOut {
        std::string property;
        EReason reason;
    };

    /// One class that has instances in at least one inventory, or for which the client made some. Counts are of this class alone,
    /// one for each inventory, without made instances.
    struct TClass {
        std::string name;
        EState state = kCompared;
        std::vector<std::size_t> instances;
        std::vector<std::size_t> madeIn;         ///< positions of the inventories that have only the one that the client made
        std::vector<std::size_t> compared;       ///< those of the inventory that the comparison looked for in the others
        std::vector<TLeftOut> leftOut;           ///< ascending by name; empty unless the state is kCompared
        std::vector<std::string> excludedKeys;   ///< in the order of the rules, also those that are no keys of the class
        std::vector<std::string> ignoredKeys;    ///< those of them that are keys, so they do not identify instances
        std::vector<std::size_t> sharing;        ///< instances that have the key of an earlier one, because keys are excluded
        std::vector<std::size_t> sharingAlone;   ///< those of `sharing` whose key the reference lacks; none of the reference itself
        std::vector<std::string> referenceKeys;  ///< excluded keys that were left out of references, in the order of the rules
        bool reducedReferences = false;          ///< whether references were compared without those keys or without a namespace

        /// Whether any instance is one of an inventory, not made by the client.
        bool HasOwnInstances() const;
        /// Whether any instance was compared.
        bool IsCompared() const;
    };

    /// Values of one property of an inventory that do not fit their type.
    struct TBadValues {
        std::size_t inventory;
        TBadProperty found;
    };

    /// What an inventory says that it lacks, for one reason.
    struct TLack {
        std::size_t inventory;
        TNotCollected what;
    };

    /// A system that an inventory calls otherwise than the reference.
    struct TName {
        std::size_t inventory;
        TOwnName name;
    };

    std::vector<TClass> classes;                                        ///< in ascending order of their names
    std::map<std::string, std::string, TNameText::TLess> superClasses;  ///< of those classes and of each one that is named here
    std::size_t classesWithout = 0;                                     ///< classes without an instance in any inventory
    std::vector<TSchemaNote> notes;     ///< what was done to make the inventories comparable, in that order
    std::vector<TBadValues> badValues;  ///< by inventory, then in the order of the files
    std::vector<TLack> lacks;           ///< by inventory, then in the order of its instances
    /// By inventory, if its keys or references were changed or do not have the name, or if TOwnName::isCommon.
    std::vector<TName> names;
    std::optional<TNameHint> hint;  ///< a class without a match, because systems are called differently

    /// Whether there were instances to compare, and every instance of every inventory was compared in every property, references
    /// as a whole, every value as what its type says, and no inventory says that it lacks anything.
    bool IsComplete() const;
    /// The same, times of collection aside: a class whose default is to include is compared without them.
    bool IsCompleteButForTimes() const;
    /// Whether no instance of any inventory was compared with anything, nor reported as missing elsewhere.
    bool IsNothingCompared() const;
    /// How many classes have instances that were compared.
    std::size_t CountComparedClasses() const;
    /// How many instances of one inventory were compared.
    std::size_t CountCompared(std::size_t inventory) const;

  private:
    bool IsComplete(bool timesCount) const;
};

}  // namespace NORVZEL20
