#include "client/report/html/TPageChanges.h"

#include "client/report/ChangeText.h"
#include "client/report/TValueTexts.h"
#include "client/text/CutText.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kLongestInLine = 240;

}  // namespace

std::string CutForLine(const std::string& text)
{
    return CutText(text, kLongestInLine);
}

std::uint32_t TPageChanges::Add(const TValueDifference& change, bool hasReference, const TValueWords& words)
{
    TPageColumns& columns = fData.columns;
    const std::vector<std::string> texts = TextsOf(change, hasReference, words);
    const std::size_t number = columns.GetCount(TPageColumns::kChangeReference);
    columns.Add(TPageColumns::kChangeReference, fData.texts.Add(texts.front()));
    columns.Add(TPageColumns::kChangeShort, fData.texts.Add(hasReference ? ShortText(change, words, texts) : std::string()));
    columns.Add(TPageColumns::kChangeGroups, columns.GetCount(TPageColumns::kGroupValue));
    for (std::size_t i = 0; i < change.others.size(); ++i) {
        const TValueDifference::TGroup& group = change.others[i];
        columns.Add(TPageColumns::kGroupValue, fData.texts.Add(texts[i + 1]));
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

void TPageChanges::Describe(const TValueDifference& change, const TValueWords& words, TPageFinding::TExample& example)
{
    const std::vector<std::string> texts = TextsOf(change, true, words);
    example.reference = CutForLine(texts.front());
    for (std::size_t i = 0; i < change.others.size(); ++i) {
        example.others.emplace_back(CutForLine(texts[i + 1]), fData.sets.Add(change.others[i].inventories));
    }
    example.shortText = CutForLine(ShortText(change, words, texts));
}

// Values of different types are shown with their types, not in words: they might look alike.
std::vector<std::string> TPageChanges::TextsOf(const TValueDifference& change, bool hasReference, const TValueWords& words)
{
    const TValueTexts plain(change, hasReference);
    bool areOfOneType = true;
    for (const TValueDifference::TGroup& group : change.others) {
        areOfOneType =
            areOfOneType && group.value.GetType() == (hasReference ? change.reference : change.others.front().value).GetType();
    }
    const auto text = [&words, areOfOneType](const TCIMValue& value, const std::string& otherwise) {
        const std::string described = areOfOneType ? words.Describe(value) : std::string();
        return described.empty() ? otherwise : described;
    };
    std::vector<std::string> texts = {hasReference ? text(change.reference, plain.GetReference()) : std::string()};
    for (std::size_t i = 0; i < change.others.size(); ++i) {
        texts.push_back(text(change.others[i].value, plain.GetOther(i)));
    }
    return texts;
}

// The words of the text report, if they say it in less than both values.
std::string TPageChanges::ShortText(const TValueDifference& change, const TValueWords& words,
                                    const std::vector<std::string>& texts) const
{
    if (change.others.size() != 1) {
        return std::string();
    }
    TChangeStyle style;
    style.isPair = true;
    style.words = &words;
    const std::string text = ChangeText(change, fNames, style);
    return text.size() < texts[0].size() + texts[1].size() ? text : std::string();
}

}  // namespace NORVZEL20
