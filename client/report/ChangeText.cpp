#include "client/report/ChangeText.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <numeric>
#include <set>
#include <utility>
#include <vector>

#include "client/report/TValueTexts.h"
#include "client/text/Counted.h"
#include "client/text/CutAround.h"
#include "client/text/DisplayText.h"
#include "client/text/EmbeddedText.h"
#include "client/text/InlineText.h"
#include "client/text/ListedText.h"
#include "client/text/TellMarksApart.h"

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
    TellMarksApart(parts);
    return boost::algorithm::join(parts, " ");
}

// The same for each group; empty if that of any group is, or if two of them look alike, since they do not say where elements stand.
std::vector<std::string> ElementsChangedInAll(const TValueDifference& change)
{
    std::vector<std::string> all;
    std::set<std::string> distinct;
    for (const TValueDifference::TGroup& group : change.others) {
        all.push_back(ElementsChanged(change.reference, group.value));
        if (all.back().empty() || !distinct.insert(all.back()).second) {
            return {};
        }
    }
    return all;
}

// The text of a value. If all values are plain ones of one type, they are quoted as this line and lists need it; otherwise
// TValueTexts has found what tells them apart.
std::string Shown(const TCIMValue& value, const TValueDifference& change, const std::string& text, const TValueWords* words)
{
    bool arePlain = !HasEmbeddedObject(change.reference);
    for (const TValueDifference::TGroup& group : change.others) {
        arePlain = arePlain && group.value.GetType() == change.reference.GetType() && !HasEmbeddedObject(group.value);
    }
    if (!arePlain) {
        return text;
    }
    const std::string described = words == nullptr ? std::string() : words->Describe(value);
    if (!described.empty()) {
        return described;
    }
    return value.GetType().IsArray() ? ListedText(value) : InlineText(value);
}

// The reference's value, then those of the groups that were chosen, cut around what differs.
std::vector<std::string> ValuesOf(const TValueDifference& change, const std::vector<std::size_t>& chosen, const TChangeStyle& style)
{
    const TValueTexts texts(change, true);
    std::vector<std::string> values{Shown(change.reference, change, texts.GetReference(), style.words)};
    for (const std::size_t i : chosen) {
        values.push_back(Shown(change.others[i].value, change, texts.GetOther(i), style.words));
    }
    TellMarksApart(values);
    return style.isWhole ? values : CutAround(values);
}

std::string OfGroup(const TValueDifference::TGroup& group, const std::string& text, const TInventoryNames& names, bool isPair)
{
    return isPair ? text : text + " (" + names.List(group.inventories) + ")";
}

// The groups in their order; of too many, those that the fewest inventories have.
std::vector<std::size_t> Choose(const std::vector<TValueDifference::TGroup>& groups, std::size_t most)
{
    std::vector<std::size_t> chosen(groups.size());
    std::iota(chosen.begin(), chosen.end(), static_cast<std::size_t>(0));
    if (chosen.size() > most) {
        std::stable_sort(chosen.begin(), chosen.end(), [&groups](std::size_t one, std::size_t other) {
            return groups[one].inventories.size() < groups[other].inventories.size();
        });
        chosen.resize(most);
    }
    return chosen;
}

}  // namespace

std::string ChangeText(const TValueDifference& change, const TInventoryNames& names, const TChangeStyle& style)
{
    const std::vector<std::size_t> chosen = Choose(change.others, style.mostValues);
    const std::vector<std::string> elements = ElementsChangedInAll(change);
    const std::vector<std::string> values = elements.empty() ? ValuesOf(change, chosen, style) : std::vector<std::string>();
    std::vector<std::string> groups;
    for (const std::size_t i : chosen) {
        groups.push_back(
            OfGroup(change.others[i], elements.empty() ? values[groups.size() + 1] : elements[i], names, style.isPair));
    }
    const std::size_t rest = change.others.size() - groups.size();
    return (elements.empty() ? values.front() + kBeforeNewValue : std::string()) + boost::algorithm::join(groups, kBetweenValues) +
           (rest > 0 ? "   ... " + Counted(rest, "more value", "more values") + " (" + style.detailOption + ")" : std::string());
}

}  // namespace NORVZEL20
