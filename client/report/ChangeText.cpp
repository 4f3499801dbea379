#include "client/report/ChangeText.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <set>
#include <utility>
#include <vector>

#include "client/report/TValueTexts.h"
#include "client/text/CutAround.h"
#include "client/text/DisplayText.h"
#include "client/text/EmbeddedText.h"
#include "client/text/InlineText.h"
#include "client/text/ListedText.h"

namespace NORVZEL20 {

namespace {

// An element with the text that tells it from others; what is shown of it may look alike.
struct TElement {
    std::string exact;
    std::string shown;
};

// Behind a sign and in front of a blank.
std::string SignedText(const TCIMValue& element)
{
    const bool hasBlank = !element.IsNull() && element.GetString().find(' ') != std::string_view::npos;
    return hasBlank ? QuoteForDisplay(element.GetString()) : InlineText(element);
}

std::vector<TElement> ElementsOf(const TCIMValue& array)
{
    std::vector<TElement> elements;
    for (const TCIMValue& element : array.GetElements()) {
        elements.push_back({DisplayValue(element), SignedText(element)});
    }
    return elements;
}

// Takes those elements out of `from` that `to` has not, as often as it has them less, and returns them.
std::vector<std::string> TakeElementsOnlyIn(std::vector<TElement>& from, const std::vector<TElement>& to)
{
    std::multiset<std::string> rest;
    for (const TElement& element : to) {
        rest.insert(element.exact);
    }
    std::vector<std::string> only;
    std::vector<TElement> common;
    for (TElement& element : from) {
        const auto same = rest.find(element.exact);
        if (same == rest.end()) {
            only.push_back(std::move(element.shown));
        } else {
            rest.erase(same);
            common.push_back(std::move(element));
        }
    }
    from = std::move(common);
    return only;
}

// Signs in front of numbers would read as theirs.
bool IsListOfTexts(const TCIMValue& value)
{
    return value.GetType() == TCIMValue::TCIMType::kArrayString && !value.IsNull() && !HasEmbeddedObject(value) &&
           !value.GetElements().empty();
}

// The elements that came and went: "-noexec +nodev". Empty if that does not say all, because the order changed too, or if nothing
// is left of the array.
std::string ElementsChanged(const TCIMValue& from, const TCIMValue& to)
{
    if (!IsListOfTexts(from) || !IsListOfTexts(to)) {
        return std::string();
    }
    std::vector<TElement> before = ElementsOf(from);
    std::vector<TElement> after = ElementsOf(to);
    const std::vector<TElement> whole = before;
    const std::vector<std::string> gone = TakeElementsOnlyIn(before, after);
    const std::vector<std::string> added = TakeElementsOnlyIn(after, whole);
    const bool isSameOrder = std::equal(before.begin(), before.end(), after.begin(), after.end(),
                                        [](const TElement& one, const TElement& other) { return one.exact == other.exact; });
    if (before.empty() || !(isSameOrder || from.IsBag())) {
        return std::string();
    }
    std::vector<std::string> parts;
    for (const std::string& text : gone) {
        parts.push_back("-" + text);
    }
    for (const std::string& text : added) {
        parts.push_back("+" + text);
    }
    return boost::algorithm::join(parts, " ");
}

// The text of a value. If all values are plain ones of one type, they are quoted as this line and lists need it; otherwise
// TValueTexts has found what tells them apart.
std::string Shown(const TCIMValue& value, const TValueDifference& change, const std::string& text)
{
    bool arePlain = !HasEmbeddedObject(change.reference);
    for (const TValueDifference::TGroup& group : change.others) {
        arePlain = arePlain && group.value.GetType() == change.reference.GetType() && !HasEmbeddedObject(group.value);
    }
    if (!arePlain) {
        return text;
    }
    return value.GetType().IsArray() ? ListedText(value) : InlineText(value);
}

std::string OfGroup(const TValueDifference::TGroup& group, const std::string& text, const TInventoryNames& names, bool isPair)
{
    return isPair ? text : text + " (" + names.List(group.inventories) + ")";
}

}  // namespace

std::string ChangeText(const TValueDifference& change, const TInventoryNames& names, bool isPair)
{
    const TValueTexts texts(change, true);
    const std::string reference = Shown(change.reference, change, texts.GetReference());
    if (change.others.size() == 1) {
        const TValueDifference::TGroup& group = change.others.front();
        const std::string elements = ElementsChanged(change.reference, group.value);
        if (!elements.empty()) {
            return OfGroup(group, elements, names, isPair);
        }
        const auto [before, after] = CutAround(reference, Shown(group.value, change, texts.GetOther(0)));
        return before + kBeforeNewValue + OfGroup(group, after, names, isPair);
    }
    std::vector<std::string> groups;
    for (std::size_t i = 0; i < change.others.size(); ++i) {
        groups.push_back(OfGroup(change.others[i], Shown(change.others[i].value, change, texts.GetOther(i)), names, isPair));
    }
    return reference + kBeforeNewValue + boost::algorithm::join(groups, kBetweenValues);
}

}  // namespace NORVZEL20
