// Values that do not fit their types.
//
// Such a value does not end a load at once, whatever is to become of it: its instance is filled on, with the value as text or NULL,
// and the value is noted here. If it is to be refused, the load fails at its end, or at the next error. The message is about the
// first value, which is the first thing that is wrong, and gives the number of all others. A value within an embedded object that
// turns out to be bad itself is taken back, since the object is discarded.
//
// Large inventories tend to have one wrong declaration and thousands of values that do not fit it, so values are counted for each
// property, and only the first is described. Its instance is named when that has ended: the keys may come behind the value.
#include "embedded/load/TBadValues.h"

#include "embedded/load/MessageText.h"

namespace NORVZEL20 {

void TBadValues::Note(TBadProperty first, bool isInInstance, bool isEmbedded)
{
    const auto [entry, isFirst] = fPositions.emplace(std::make_pair(first.className, first.property), fFound.size());
    if (isFirst) {
        fFound.push_back(std::move(first));
        if (isInInstance) {
            fNameless.push_back(entry->second);
        }
    }
    ++fFound[entry->second].count;
    if (isEmbedded) {
        fEmbedded.push_back(entry->second);
    }
}

/// The last one comes first, so a record that becomes empty is the last one.
void TBadValues::TakeBack(std::size_t mark) noexcept
{
    for (; fEmbedded.size() > mark; fEmbedded.pop_back()) {
        const std::size_t position = fEmbedded.back();
        if (--fFound[position].count > 0) {
            continue;
        }
        if (!fNameless.empty() && fNameless.back() == position) {
            fNameless.pop_back();
        }
        fPositions.erase(fPositions.find({fFound[position].className, fFound[position].property}));
        fFound.pop_back();
    }
}

void TBadValues::NameInstance(const TCIMReference& path)
{
    TCIMReference local(path);
    local.SetNamespaceName("");
    const std::string text = local.ToText();
    for (const std::size_t position : fNameless) {
        fFound[position].instance = text;
    }
    fNameless.clear();
}

std::string TBadValues::Describe(bool isWhole) const
{
    std::size_t others = 0;
    for (const TBadProperty& property : fFound) {
        others += property.count;
    }
    --others;
    const TBadProperty& first = fFound.front();
    std::string text = "found " + Quote(first.text) + " in property " + Quote(first.property) + " of class " +
                       Quote(first.className) + ", expected a " + first.type;
    if (!first.instance.empty()) {
        text += " (instance " + QuoteIfLong(first.instance) + ")";
    }
    if (others > 0) {
        text += std::string(isWhole ? "; " : "; at least ") + std::to_string(others) + " more " +
                (others == 1 ? "value does not fit its type" : "values do not fit their types");
    }
    return text + (others > 0 ? "; correct them" : "; correct it") + ", or have such values loaded as " +
           (fHasKey ? "text" : "NULL or as text");
}

}  // namespace NORVZEL20
