#pragma once

#include <cstddef>
#include <string>

namespace NORVZEL20 {

/// A property with values that do not fit its type, as a load has met them. The first of them is the example.
struct TBadProperty {
    std::string className;
    std::string property;
    std::size_t count = 0;      ///< how many values
    bool isKeptAsText = false;  ///< whether the load keeps them as text; otherwise they are NULL

    std::string text;      ///< what did not fit, cut if it is long
    std::string type;      ///< the type that it should have, as messages call it: "uint16"
    std::string instance;  ///< the path of the instance that it stands in, without namespace; empty if that is not known
    std::string document;  ///< what messages call the document
    std::size_t line = 0;
    std::size_t column = 0;
};

}  // namespace NORVZEL20
