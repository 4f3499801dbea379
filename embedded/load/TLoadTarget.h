#pragma once

#include <cstdint>
#include <limits>
#include <string>

#include "embedded/load/EValueText.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// A property of a class whose instances are filled. Valid as long as the TLoadLayout that it is part of.
struct TLoadTarget {
    /// What a start tag of the property means.
    struct TTag {
        std::uint64_t number = std::numeric_limits<std::uint64_t>::max();  ///< unique in the load; at first, that of no tag
        TCIMValue::TCIMType type = TCIMValue::TCIMType::kNone;
        EValueText text = EValueText::kPlain;
    };

    const std::string* name = nullptr;  ///< as declared
    std::uint32_t slot = 0;
    TCIMValue::TCIMType type = TCIMValue::TCIMType::kNone;
    bool isEmbedded = false;      ///< whether text may be an embedded object, as the declaration says
    bool isStatic = false;        ///< whether all instances share the value
    bool isKeptAsIs = false;      ///< whether an instance holds values of that type as they are: see TInMemInstance::FillSlot
    std::uint32_t given = 0;      ///< the number of the last instance that had the property
    TTag tag;                     ///< the last one of the property
    TLoadTarget* next = nullptr;  ///< the property declared after it
};

}  // namespace NORVZEL20
