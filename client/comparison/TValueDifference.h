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
        std::vector<std::size_t> instances;    ///< for each of `inventories`, how many of its instances have the value
        TCIMValue value;                       ///< of the first of them; the others' are of its type and equal under the rules

        /// Notes `count` more instances of `inventory`.
        void Add(std::size_t inventory, std::size_t count);
    };

    /// Whether two values are equal.
    using TEqual = boost::function<bool(const TCIMValue&, const TCIMValue&)>;

    /// The group of `value`, added to `others` if there is none yet. A null is equal to a null of another type, but a group has one
    /// type, so that it can be shown.
    TGroup& GetGroup(const TCIMValue& value, const TEqual& areEqual);
    /// Whether not all values of `others` are equal.
    bool DoOthersDiffer(const TEqual& areEqual) const;

    std::string property;
    TCIMValue reference;         ///< the reference's value before the run; meaningless if the reference lacks the instance
    std::vector<TGroup> others;  ///< the values that are not the reference's, equal ones together
    /// Of embedded instances: the same difference property by property, if that says all; see EmbeddedParts.h. The property is then
    /// a path such as `Settings.Speed`.
    std::vector<TValueDifference> parts;
};

}  // namespace NORVZEL20
