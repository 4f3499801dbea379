#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// What an XML document may have at most. A document that exceeds a bound is in error.
struct TXmlLimits {
    TXmlLimits() = delete;

    static constexpr std::size_t kMaxDepth = 10000;               ///< open elements
    static constexpr std::size_t kMaxAttributes = 1000;           ///< attributes of one element
    static constexpr std::size_t kMaxTextLength = 128u << 20;     ///< bytes of text between two tags
    static constexpr std::size_t kMaxTokenLength = 16u << 20;     ///< bytes of one tag, comment or other markup
    static constexpr std::size_t kMaxEntities = 1000;             ///< entities that a document declares
    static constexpr std::size_t kExpansionThreshold = 4u << 20;  ///< bytes of output from which on the amplification is checked
    static constexpr float kMaxAmplification = 20.0F;             ///< output over input of entities and of attribute defaults
};

}  // namespace NORVZEL20
