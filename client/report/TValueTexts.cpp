#include "client/report/TValueTexts.h"

#include <algorithm>
#include <string_view>

#include "client/text/DisplayText.h"
#include "client/text/EmbeddedText.h"
#include "client/text/TellMarksApart.h"

namespace NORVZEL20 {

namespace {

using TValues = std::vector<const TCIMValue*>;

bool HaveTypesThatDiffer(const TValues& values)
{
    const TCIMValue* object = nullptr;
    const TCIMValue* plain = nullptr;
    for (const TCIMValue* const value : values) {
        if (value->GetType() != values.front()->GetType()) {
            return true;
        }
        if (!value->IsNull()) {
            (HasEmbeddedObject(*value) ? object : plain) = value;
        }
    }
    return object != nullptr && plain != nullptr;
}

bool LookAlike(const std::vector<std::string>& texts)
{
    std::vector<std::string_view> sorted(texts.begin(), texts.end());
    std::sort(sorted.begin(), sorted.end());
    return std::adjacent_find(sorted.begin(), sorted.end()) != sorted.end();
}

}  // namespace

TValueTexts::TValueTexts(const TValueDifference& difference, bool hasReference) : fGroups(difference.others.size())
{
    TValues values;
    if (hasReference) {
        values.push_back(&difference.reference);
    }
    for (const TValueDifference::TGroup& group : difference.others) {
        values.push_back(&group.value);
    }
    for (const TCIMValue* const value : values) {
        fTexts.push_back(DisplayContents(*value));
    }
    const bool isExact = LookAlike(fTexts);
    const bool isTyped = HaveTypesThatDiffer(values);
    for (std::size_t i = 0; i < values.size() && (isExact || isTyped); ++i) {
        fTexts[i] =
            (isTyped ? DescribeContents(*values[i]) + " " : std::string()) + (isExact ? DisplayValue(*values[i]) : fTexts[i]);
    }
    TellMarksApart(fTexts);
}

}  // namespace NORVZEL20
