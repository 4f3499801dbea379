#include "client/text/TValueNames.h"

#include <algorithm>
#include <boost/algorithm/string/trim.hpp>
#include <charconv>

namespace NORVZEL20 {

bool TValueNames::TInteger::operator<(const TInteger& other) const
{
    if (isNegative != other.isNegative) {
        return isNegative;
    }
    return isNegative ? other.magnitude < magnitude : magnitude < other.magnitude;
}

bool TValueNames::TRange::Holds(const TInteger& integer) const
{
    return !(first && integer < *first) && !(last && *last < integer);
}

TValueNames::TValueNames(const std::vector<std::string>& map, const std::vector<std::string>& names)
{
    for (std::size_t i = 0; i < names.size() && (map.empty() || i < map.size()); ++i) {
        Add(map.empty() ? std::to_string(i) : boost::algorithm::trim_copy(map[i]), names[i]);
    }
    std::stable_partition(fRanges.begin(), fRanges.end(), [](const TRange& range) { return range.IsOne(); });
}

void TValueNames::Add(const std::string& values, const std::string& name)
{
    if (name.empty()) {
        return;
    }
    if (values == "..") {
        fOthers = name;
        return;
    }
    const std::size_t dots = values.find("..");
    const std::string begin = values.substr(0, dots);
    const std::string end = dots == std::string::npos ? begin : values.substr(dots + 2);
    const TRange range{Parse(begin), Parse(end), name};
    if ((range.first || begin.empty()) && (range.last || end.empty()) && (range.first || range.last)) {
        fRanges.push_back(range);
    }
}

// Decimal, or hexadecimal behind 0x.
std::optional<TValueNames::TInteger> TValueNames::Parse(const std::string& text)
{
    constexpr int kDecimal = 10;
    constexpr int kHexadecimal = 16;
    std::string digits = boost::algorithm::trim_copy(text);
    const bool isNegative = digits.compare(0, 1, "-") == 0;
    digits.erase(0, isNegative || digits.compare(0, 1, "+") == 0 ? 1 : 0);
    const bool isHexadecimal = digits.compare(0, 2, "0x") == 0 || digits.compare(0, 2, "0X") == 0;
    digits.erase(0, isHexadecimal ? 2 : 0);
    TInteger integer{isNegative, 0};
    const char* const end = digits.data() + digits.size();
    const auto [stop, error] = std::from_chars(digits.data(), end, integer.magnitude, isHexadecimal ? kHexadecimal : kDecimal);
    if (digits.empty() || error != std::errc() || stop != end) {
        return std::nullopt;
    }
    integer.isNegative = isNegative && integer.magnitude > 0;
    return integer;
}

const std::string* TValueNames::Find(const TCIMValue& integer) const
{
    const TCIMValue::TCIMType type = integer.GetType();
    if (integer.IsNull() || type < TCIMValue::TCIMType::kUint8 || type > TCIMValue::TCIMType::kSint64) {
        return nullptr;
    }
    const std::optional<TInteger> number = Parse(integer.ToText());
    for (const TRange& range : fRanges) {
        if (number && range.Holds(*number)) {
            return &range.name;
        }
    }
    return fOthers ? &*fOthers : nullptr;
}

}  // namespace NORVZEL20
