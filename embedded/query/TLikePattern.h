#pragma once

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace NORVZEL20 {

/// A pattern of the operator LIKE: % stands for any text, _ for one character, [a-z] for one of the characters, [^a-z] for any
/// other. Whatever stands in brackets alone means itself: [%] is a percent sign. A bracket that is not closed means itself too.
class TLikePattern {
  public:
    /// UTF-8; bytes that are not count as one character each. Cost: in proportion to the pattern.
    explicit TLikePattern(std::string_view pattern);

    /// Whether the whole of `text` fits. Letter case counts. At most the product of both lengths in steps.
    bool Matches(std::string_view text) const;

  private:
    struct TStep {
        enum EKind { kAnyText, kAnyCharacter, kOneOf, kNoneOf };

        EKind kind;
        std::vector<std::pair<char32_t, char32_t>> ranges;  ///< first and last of each
    };

    static bool Fits(const TStep& step, char32_t character);
    std::size_t ReadSet(const std::vector<char32_t>& pattern, std::size_t at);

    std::vector<TStep> fSteps;
};

}  // namespace NORVZEL20
