#include "client/report/TValueTexts.h"

#include <set>

#include "client/text/DisplayText.h"
#include "client/text/EmbeddedText.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

TValueTexts::TValueTexts(const TValueDifference& difference, bool hasReference)
{
    std::vector<TCIMValue> values;
    if (hasReference) {
        values.push_back(difference.reference);
    }
    for (const TValueDifference::TGroup& group : difference.others) {
        values.push_back(group.value);
    }
    std::set<std::string> types;
    std::set<std::string> contents;
    std::set<std::string> texts;
    for (const TCIMValue& value : values) {
        types.insert(TValueText::DescribeType(value.GetType()));
        if (!value.IsNull()) {
            contents.insert(DescribeContents(value));
        }
        texts.insert(DisplayContents(value));
    }
    fWithTypes = types.size() > 1 || contents.size() > 1;
    fExact = texts.size() < values.size();
}

std::string TValueTexts::Get(const TCIMValue& value) const
{
    return (fWithTypes ? DescribeContents(value) + " " : std::string()) + (fExact ? DisplayValue(value) : DisplayContents(value));
}

}  // namespace NORVZEL20
