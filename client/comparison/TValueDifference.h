#pragma once

#include <boost/function.hpp>
#include <cstddef>
#include <string>
#include <vector>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// A property whose values are not all equal.
struct TValueDifference {
    /// One value and the inventories that have it.
    struct TGroup {
        std::vector<std::size_t> inventories;  ///< ascending
        TCIMValue value;                       ///< of the first of them; the others' are of its type and equal under the rules

        /// Notes `count` more instances of `inventory`.
        void Add(std::size_t inventory, std::size_t count);
        /// How many instances of the inventory at `position` of `inventories` have the value.
        std::size_t CountInstances(std::size_t position) const { return instances.empty() ? 1 : instances[position]; }

        /// The same counts; empty if all are 1. Only inventories in which instances share a key have others, and there are as many
        /// groups as differences, so memory counts.
        std::vector<std::size_t> instances;
    };

    /// Whether two values are equal.
    using TEqual = boost::function<bool(const TCIMValue&, const TCIMValue&)>;

    std::string property;
    TCIMValue reference;         ///< the reference's value before the run; meaningless if the reference lacks the instance
    std::vector<TGroup> others;  ///< the values that are not the reference's, equal ones together; see TValueGroups
    /// Of embedded instances: the same difference property by property, if that says all; see EmbeddedParts.h. The property is then
    /// a path such as `Settings.Speed`.
    std::vector<TValueDifference> parts;
};

}  // namespace NORVZEL20
