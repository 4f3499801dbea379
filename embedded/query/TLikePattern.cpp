// Patterns of LIKE.
//
// A pattern is cut into steps: any text (%), any character (_), one of a set of characters, or none of a set. A character that
// means itself is a set of one. Text and pattern are decoded first, so a step always stands for one character of UTF-8.
//
// Matching walks along the text and the steps at once. A % matches nothing at first. If a later step fails, the walk goes back to
// the last % and lets it take one character more. Going back to an earlier % is never needed: any text that it could skip, the last
// one can skip too. That bounds the work by the product of both lengths.

#include "embedded/query/TLikePattern.h"

#include <algorithm>

#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

/// A byte outside of UTF-8 gets a number beyond those of the characters, so it equals only the same byte.
std::vector<char32_t> Decode(std::string_view text)
{
    constexpr char32_t kFirstByte = 0x110000;
    std::vector<char32_t> characters;
    characters.reserve(text.size());
    while (!text.empty()) {
        const TUtf8::TCharacter character = TUtf8::Decode(text);
        const bool isCharacter = character.length != 0;
        characters.push_back(isCharacter ? character.code : kFirstByte + character.code);
        text.remove_prefix(isCharacter ? character.length : 1);
    }
    return characters;
}

}  // namespace

TLikePattern::TLikePattern(std::string_view pattern)
{
    const std::vector<char32_t> characters = Decode(pattern);
    bool canClose = true;  // once a bracket is not closed, no later one can be: this spares the search for its end
    for (std::size_t at = 0; at < characters.size();) {
        const char32_t character = characters[at];
        const bool opens = character == U'[' && canClose;
        const std::size_t end = opens ? ReadSet(characters, at + 1) : 0;
        canClose = canClose && (!opens || end != 0);
        if (end != 0) {
            at = end;
            continue;
        }
        if (character == U'%') {
            fSteps.push_back(TStep{TStep::kAnyText, {}});
        } else if (character == U'_') {
            fSteps.push_back(TStep{TStep::kAnyCharacter, {}});
        } else {
            fSteps.push_back(TStep{TStep::kOneOf, {{character, character}}});
        }
        ++at;
    }
}

/// Reads the set whose opening bracket is in front of `at`. Returns the position behind its closing bracket, or 0 if it has none.
/// A closing bracket that comes first is part of the set.
std::size_t TLikePattern::ReadSet(const std::vector<char32_t>& pattern, std::size_t at)
{
    const bool isInverted = at < pattern.size() && pattern[at] == U'^';
    TStep set{isInverted ? TStep::kNoneOf : TStep::kOneOf, {}};
    at += isInverted ? 1 : 0;
    for (bool isFirst = true; at < pattern.size(); isFirst = false) {
        if (pattern[at] == U']' && !isFirst) {
            fSteps.push_back(std::move(set));
            return at + 1;
        }
        const bool isRange = at + 2 < pattern.size() && pattern[at + 1] == U'-' && pattern[at + 2] != U']';
        const std::size_t last = isRange ? at + 2 : at;
        set.ranges.emplace_back(pattern[at], pattern[last]);
        at = last + 1;
    }
    return 0;
}

bool TLikePattern::Fits(const TStep& step, char32_t character)
{
    if (step.kind == TStep::kAnyCharacter) {
        return true;
    }
    const bool isIn = std::any_of(step.ranges.begin(), step.ranges.end(),
                                  [character](const auto& range) { return range.first <= character && character <= range.second; });
    return isIn == (step.kind == TStep::kOneOf);
}

bool TLikePattern::Matches(std::string_view text) const
{
    const std::vector<char32_t> characters = Decode(text);
    std::size_t step = 0;
    std::size_t at = 0;
    std::size_t retryStep = fSteps.size();  // the step behind the last % so far
    std::size_t retryAt = 0;                // the end of what that % matches so far
    bool canRetry = false;
    while (at < characters.size() || step < fSteps.size()) {
        if (step < fSteps.size() && fSteps[step].kind == TStep::kAnyText) {
            retryStep = ++step;
            retryAt = at;
            canRetry = true;
        } else if (step < fSteps.size() && at < characters.size() && Fits(fSteps[step], characters[at])) {
            ++step;
            ++at;
        } else if (canRetry && retryAt < characters.size()) {
            step = retryStep;
            at = ++retryAt;
        } else {
            return false;
        }
    }
    return true;
}

}  // namespace NORVZEL20
