// One name for a system that inventories call differently.
//
// Each inventory has a name N of its own, and the reference has R. In keys and references N becomes R, in any letter case, since
// names of hosts have none. A text that says R already means another system, so it must not be equal to what was N:
//
//     N                     R
//     R                     R (another system)
//     R (another system)    R (another system) (another system)
//
// and so on. No two texts become one, spellings of N aside, and no text but N becomes R. In the reference itself N is R; the third
// line holds there too, so the marked form stands for no text of the reference either.
#include "client/inventory/TNameReplacement.h"

#include <cctype>
#include <string>

#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

constexpr std::string_view kMark = kAnotherSystem;

// The text without the marks behind it.
std::string_view WithoutMarks(std::string_view text)
{
    while (text.size() >= kMark.size() && text.substr(text.size() - kMark.size()) == kMark) {
        text.remove_suffix(kMark.size());
    }
    return text;
}

bool IsWordPart(char c)
{
    return std::isalnum(static_cast<unsigned char>(c)) != 0;
}

// Whether the name is part of the text, and not of a longer word.
bool Holds(std::string_view text, std::string_view name)
{
    for (std::size_t at = 0; at + name.size() <= text.size(); ++at) {
        const std::size_t end = at + name.size();
        if (TNameText::Equal(text.substr(at, name.size()), name) && (at == 0 || !IsWordPart(text[at - 1])) &&
            (end == text.size() || !IsWordPart(text[end]))) {
            return true;
        }
    }
    return false;
}

}  // namespace

TCIMValue TNameReplacement::Replace(std::string_view text, const TKeyTexts::TPlace& place)
{
    for (TOwnName& own : fNames) {
        if (!own.isInKeys) {
            continue;
        }
        if (TNameText::Equal(text, own.name)) {
            if (text == own.comparedAs) {
                return TCIMValue();
            }
            ++own.replaced;
            return TCIMValue::FromText(own.comparedAs);
        }
        if (TNameText::Equal(WithoutMarks(text), own.comparedAs)) {
            if (text.size() == own.comparedAs.size() && TNameText::Equal(own.name, own.comparedAs)) {
                return TCIMValue();
            }
            ++own.marked;
            return TCIMValue::FromText(std::string(text) + kAnotherSystem);
        }
    }
    for (TOwnName& own : fNames) {
        if (!place.isInReference && own.name != own.comparedAs && Holds(text, own.name)) {
            ++own.within[std::string(place.className) + "." + std::string(place.key)];
        }
    }
    return TCIMValue();
}

}  // namespace NORVZEL20
