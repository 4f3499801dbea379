#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/comparison/TDifference.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

/// A difference that somebody accepted, as a baseline keeps it: everything is text, so it can be compared with a later run.
struct TAcceptedDifference {
    /// A property, and its values as ValueIdentity writes them.
    struct TValue {
        std::string property;
        std::string before;  ///< the reference's value; empty unless the kind is kChanged
        std::string after;   ///< the value of `inventories`
    };

    TDifference::EKind kind;
    std::string instance;        ///< the class and the key
    std::vector<TValue> values;  ///< of kChanged the property, of kOnlyInOthers what the instance holds, ascending by name in any
                                 ///< letter case
    std::vector<std::string> inventories;    ///< labels, ascending, each once
    std::string reason = std::string();      ///< why it is accepted; empty if nobody said
    std::vector<std::string> comments = {};  ///< the lines of comment above it
    std::size_t line = 0;                    ///< where the file has it; 0 if it is of no file
};

inline bool operator==(const TAcceptedDifference::TValue& one, const TAcceptedDifference::TValue& other)
{
    return TNameText::Equal(one.property, other.property) && one.before == other.before && one.after == other.after;
}

}  // namespace NORVZEL20
