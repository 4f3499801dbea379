#pragma once

#include <string_view>
#include <utility>
#include <vector>

#include "host/Export.h"

namespace NORVZEL20 {

/// A pattern of the operator LIKE: % stands for any text, _ for one character, [a-z] for one of the characters, [^a-z] for any
/// other. A single character in brackets means itself: [%] is a percent sign. A bracket that is not closed means itself too.
class CIMDELTA_INTERNAL_EXPORT TLikePattern {
  public:
    /// The pattern is in UTF-8; a byte that is not UTF-8 counts as one character. Cost: linear.
    explicit TLikePattern(std::string_view pattern);

    /// Whether the pattern fits the whole of `text`. Letter case matters. Cost: at most the product of both lengths.
    bool Matches(std::string_view text) const;

  private:
    struct TStep {
        enum EKind { kAnyText, kAnyCharacter, kOneOf, kNoneOf };

        EKind kind;
        std::vector<std::pair<char32_t, char32_t>> ranges;  ///< first and last of each
    };

    /// Whether the step, which must take one character, takes this one.
    static bool Fits(const TStep& step, char32_t character);
    std::size_t ReadSet(const std::vector<char32_t>& pattern, std::size_t at);

    std::vector<TStep> fSteps;
};

}  // namespace NORVZEL20
