#include "client/report/TInventoryNames.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <string_view>

#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kShortestRange = 3;
constexpr std::size_t kFewestForAll = 3;
constexpr std::size_t kFewestForAllBut = 4;
constexpr std::size_t kMostExceptions = 2;

bool IsDigit(char c)
{
    return c >= '0' && c <= '9';
}

std::size_t NumberBegin(std::string_view label)
{
    std::size_t begin = label.size();
    while (begin > 0 && IsDigit(label[begin - 1])) {
        --begin;
    }
    return begin;
}

// Whether the number at the end of `next` follows that of `label`, with as many digits and the same text before it.
bool IsNext(const std::string& label, const std::string& next)
{
    constexpr std::size_t kMostDigits = 18;  // of a number that surely fits
    const std::size_t begin = NumberBegin(label);
    const std::size_t digits = label.size() - begin;
    if (digits == 0 || digits > kMostDigits || label.size() != next.size() || label.compare(0, begin, next, 0, begin) != 0 ||
        NumberBegin(next) != begin) {
        return false;
    }
    return std::stoull(label.substr(begin)) + 1 == std::stoull(next.substr(begin));
}

}  // namespace

std::string TInventoryNames::List(const std::vector<std::size_t>& inventories) const
{
    if (!AreNearlyAll(inventories)) {
        return Ranges(inventories);
    }
    const std::vector<std::size_t> others = Others(inventories, 1);
    return others.empty() ? "all" : "all but " + Ranges(others);
}

std::string TInventoryNames::WhoLacks(const std::vector<std::size_t>& inventories) const
{
    const std::vector<std::size_t> others = Others(inventories, fHasMajority ? 1 : 0);
    return AreNearlyAll(inventories) && !others.empty() ? "only in " + Ranges(others) : "missing in " + List(inventories);
}

std::string TInventoryNames::WhoHas(const std::vector<std::size_t>& inventories) const
{
    const std::vector<std::size_t> others = Others(inventories, fHasMajority ? 1 : 0);
    return AreNearlyAll(inventories) && !others.empty() ? "missing in " + Ranges(others) + " alone"
                                                        : "only in " + List(inventories);
}

// Whether they are all others, or so many that those are odd that are not among them, the reference included. Who is odd is named.
bool TInventoryNames::AreNearlyAll(const std::vector<std::size_t>& inventories) const
{
    const std::size_t others = fLabels.size() - 1;
    if (inventories.front() == 0 || others < kFewestForAll) {
        return false;
    }
    const std::size_t exceptions = others - inventories.size();
    const std::size_t odd = exceptions + (fHasMajority ? 0 : 1);
    return exceptions == 0 || (others >= kFewestForAllBut && exceptions <= kMostExceptions && odd < inventories.size());
}

std::vector<std::size_t> TInventoryNames::Others(const std::vector<std::size_t>& inventories, std::size_t first) const
{
    std::vector<std::size_t> others;
    for (std::size_t i = first; i < fLabels.size(); ++i) {
        if (!std::binary_search(inventories.begin(), inventories.end(), i)) {
            others.push_back(i);
        }
    }
    return others;
}

std::string TInventoryNames::Ranges(const std::vector<std::size_t>& inventories) const
{
    std::vector<std::string> parts;
    for (std::size_t first = 0; first < inventories.size();) {
        std::size_t last = first;
        while (last + 1 < inventories.size() && IsNext(fLabels[inventories[last]], fLabels[inventories[last + 1]])) {
            ++last;
        }
        const std::string& begin = fLabels[inventories[first]];
        const std::string& end = fLabels[inventories[last]];
        if (last + 1 - first >= kShortestRange && DisplayLabel(begin) == begin) {
            parts.push_back(begin + ".." + end.substr(NumberBegin(end)));
            first = last + 1;
        } else {
            parts.push_back(DisplayLabel(begin));
            ++first;
        }
    }
    return boost::algorithm::join(parts, ", ");
}

}  // namespace NORVZEL20
