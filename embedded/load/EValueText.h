#pragma once

namespace NORVZEL20 {

/// What the text of a string value may be.
enum class EValueText : unsigned char {
    kPlain,         ///< text alone
    kObject,        ///< an embedded object, because the document marks the element so; empty text stays text
    kPerhapsObject  ///< an embedded object if it looks like one: the class declares so, but the document does not mark it
};

}  // namespace NORVZEL20
