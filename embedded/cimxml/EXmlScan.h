#pragma once

namespace NORVZEL20 {

/// What the tokenizer says of a token that begins at a place.
enum class EXmlScan : unsigned char {
    kAccepted,  ///< it is complete, and one that the tokenizer knows
    kCutOff,    ///< it may be, but the bytes end within it
    kRefused    ///< Expat has to decide
};

}  // namespace NORVZEL20
