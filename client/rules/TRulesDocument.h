#pragma once

#include <map>
#include <string>
#include <vector>

#include "engine/TCIMDiffEngine.h"

namespace NORVZEL20 {

/// What a specification file says, in its order and with its lines, for telling a person where a rule comes from.
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
        std::vector<TListed> listed;  ///< in the order read; of several with one name the first one counts
    };

    std::vector<TElement> elements;

    /// Reads a file that the plug-in accepts; of any other, what stands before the first fault in its XML.
    /// Errors: TClientError where the file cannot be read.
    static TRulesDocument Read(const std::string& path);

    /// The element that `line` belongs to: the last one that begins there or before; null where there is none.
    const TElement* FindByLine(unsigned int line) const;
};

}  // namespace NORVZEL20
