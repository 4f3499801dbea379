#pragma once

#include <string>
#include <vector>

#include "engine/TCIMDiffEngine.h"

namespace NORVZEL20 {

/// What a rules file says, in its order and with its lines. Several elements may stand on one line: an element is known by its
/// position here, and its line is only for display.
struct TRulesDocument {
    /// A property named in a list.
    struct TListed {
        std::string property;
        TCIMDiffEngine::propType treatment;
        unsigned int line;
    };

    /// One element "class".
    struct TElement {
        std::string className;
        TCIMDiffEngine::propType defaultTreatment = TCIMDiffEngine::EXCLUDE;
        std::vector<std::string> excludedKeys;
        unsigned int line = 0;
        std::vector<TListed> listed;  ///< in the order read; if a property is listed twice, the first listing counts
        bool hasDefault = false;      ///< whether the element names a default; otherwise the default is to exclude
    };

    std::vector<TElement> elements;
};

}  // namespace NORVZEL20
