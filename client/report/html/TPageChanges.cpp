#include "client/report/html/TPageChanges.h"

#include "client/report/ChangeText.h"
#include "client/report/TValueTexts.h"
#include "client/text/DisplayText.h"
#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kLongestInLine = 240;

}  // namespace

std::string CutForLine(const std::string& text)
{
    const std::string_view start = TUtf8::Shorten(text, kLongestInLine);
    return start.size() == text.size() ? text : std::string(start) + "...";
}

std::uint32_t TPageChanges::Add(const TValueDifference& change, bool hasReference)
{
    TPageColumns& columns = fData.columns;
    const TValueTexts texts(change, hasReference);
    const std::string reference = hasReference ? texts.GetReference() : std::string();
    const std::string shortText =
        hasReference && change.others.size() == 1 ? ShortText(change, reference, texts.GetOther(0)) : std::string();
    const std::size_t number = columns.GetCount(TPageColumns::kChangeReference);
    columns.Add(TPageColumns::kChangeReference, fData.texts.Add(reference));
    columns.Add(TPageColumns::kChangeShort, fData.texts.Add(shortText));
    columns.Add(TPageColumns::kChangeGroups, columns.GetCount(TPageColumns::kGroupValue));
    for (std::size_t i = 0; i < change.others.size(); ++i) {
        const TValueDifference::TGroup& group = change.others[i];
        columns.Add(TPageColumns::kGroupValue, fData.texts.Add(texts.GetOther(i)));
        columns.Add(TPageColumns::kGroupSet, fData.sets.Add(group.inventories));
        columns.Add(TPageColumns::kGroupCounts, AddList(group.instances));
    }
    return static_cast<std::uint32_t>(number);
}

std::uint32_t TPageChanges::AddList(const std::vector<std::size_t>& numbers)
{
    TPageColumns& columns = fData.columns;
    if (columns.GetCount(TPageColumns::kListNumbers) == 0) {
        columns.Add(TPageColumns::kListNumbers, 0);
    }
    if (numbers.empty()) {
        return 0;
    }
    const std::size_t list = columns.GetCount(TPageColumns::kListNumbers);
    columns.Add(TPageColumns::kListNumbers, columns.GetCount(TPageColumns::kNumber));
    for (const std::size_t number : numbers) {
        columns.Add(TPageColumns::kNumber, number);
    }
    return static_cast<std::uint32_t>(list);
}

void TPageChanges::Describe(const TValueDifference& change, TPageFinding::TExample& example)
{
    const TValueTexts texts(change, true);
    example.reference = CutForLine(texts.GetReference());
    for (std::size_t i = 0; i < change.others.size(); ++i) {
        example.others.emplace_back(CutForLine(texts.GetOther(i)), fData.sets.Add(change.others[i].inventories));
    }
    if (change.others.size() == 1) {
        example.shortText = CutForLine(ShortText(change, texts.GetReference(), texts.GetOther(0)));
    }
}

// The words of the text report, if they say it in less than both values.
std::string TPageChanges::ShortText(const TValueDifference& change, const std::string& reference, const std::string& other) const
{
    const std::string text = ChangeText(change, fNames, true);
    return text.size() < reference.size() + other.size() ? text : std::string();
}

}  // namespace NORVZEL20
