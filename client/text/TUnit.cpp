// A PUnit is a base unit, perhaps with powers of a number behind it: "byte", "byte * 2^10", "hertz * 10^6", "bit / second * 10^3".
// Powers of ten become the prefixes of such units, and bytes are counted. A unit that is not known is shown as it is written.
#include "client/text/TUnit.h"

#include <algorithm>
#include <boost/algorithm/string/case_conv.hpp>
#include <boost/algorithm/string/classification.hpp>
#include <boost/algorithm/string/split.hpp>
#include <boost/algorithm/string/trim.hpp>
#include <limits>
#include <optional>
#include <vector>

#include "client/text/DisplayText.h"
#include "client/text/InlineText.h"
#include "client/text/NumberIn.h"

namespace NORVZEL20 {

namespace {

const struct {
    const char* unit;
    const char* shown;
} kBaseUnits[] = {{"bit", "bit"},
                  {"bit / second", "bit/s"},
                  {"byte / second", "B/s"},
                  {"hertz", "Hz"},
                  {"second", "s"},
                  {"ampere", "A"},
                  {"volt", "V"},
                  {"watt", "W"},
                  {"joule", "J"},
                  {"percent", "%"},
                  {"degree celsius", "C"},
                  {"revolution / minute", "rpm"}};

const struct {
    int exponent;
    const char* prefix;
} kPrefixes[] = {{-9, "n"}, {-6, "u"}, {-3, "m"}, {0, ""}, {3, "k"}, {6, "M"}, {9, "G"}, {12, "T"}};

const struct {
    const char* units;
    const char* shown;
} kOldUnits[] = {{"percent", "%"},     {"seconds", "s"},     {"milliseconds", "ms"},       {"microseconds", "us"},
                 {"hertz", "Hz"},      {"megahertz", "MHz"}, {"bits per second", "bit/s"}, {"milliamps", "mA"},
                 {"millivolts", "mV"}, {"watts", "W"}};

struct TPower {
    std::uint64_t base;
    int exponent;
};

// "10^6", "2^-3", "1000".
std::optional<TPower> PowerOf(const std::string& text)
{
    const std::size_t caret = text.find('^');
    const std::optional<std::uint64_t> base = NumberIn(text.substr(0, caret));
    if (!base || caret == std::string::npos) {
        return base ? std::optional<TPower>({*base, 1}) : std::nullopt;
    }
    const bool isNegative = text.compare(caret + 1, 1, "-") == 0;
    const std::optional<std::uint64_t> exponent = NumberIn(text.substr(caret + (isNegative ? 2 : 1)));
    constexpr std::uint64_t kMostExponent = 63;
    if (!exponent || *exponent > kMostExponent) {
        return std::nullopt;
    }
    return TPower{*base, static_cast<int>(*exponent) * (isNegative ? -1 : 1)};
}

// 0 if the product is no number of 64 bits.
std::uint64_t Multiply(const std::vector<TPower>& powers)
{
    std::uint64_t product = 1;
    for (const TPower& power : powers) {
        for (int i = 0; i < power.exponent; ++i) {
            if (power.base == 0 || product > std::numeric_limits<std::uint64_t>::max() / power.base) {
                return 0;
            }
            product *= power.base;
        }
        product = power.exponent < 0 ? 0 : product;
    }
    return product;
}

// The prefix for powers of ten; null if there is none.
const char* PrefixOf(const std::vector<TPower>& powers)
{
    int exponent = 0;
    for (const TPower& power : powers) {
        if (power.base != 10) {
            return nullptr;
        }
        exponent += power.exponent;
    }
    for (const auto& prefix : kPrefixes) {
        if (prefix.exponent == exponent) {
            return prefix.prefix;
        }
    }
    return nullptr;
}

// "KiloBytes" of one is "KiloByte", "Bits per Second" is "Bit per Second"; "Celsius" and "Gauss" stay.
std::string SingularOf(const std::string& name)
{
    const std::size_t end = std::min(name.find(' '), name.size());
    const bool isPlural = end > 2 && name[end - 1] == 's' && name[end - 2] != 's' && name[end - 2] != 'u';
    return isPlural ? name.substr(0, end - 1) + name.substr(end) : name;
}

bool IsUnsigned(TCIMValue::TCIMType type)
{
    return type == TCIMValue::TCIMType::kUint8 || type == TCIMValue::TCIMType::kUint16 || type == TCIMValue::TCIMType::kUint32 ||
           type == TCIMValue::TCIMType::kUint64;
}

bool IsNumber(TCIMValue::TCIMType type)
{
    return type >= TCIMValue::TCIMType::kUint8 && type <= TCIMValue::TCIMType::kReal64;
}

}  // namespace

TUnit::TUnit(const std::string& programmatic, const std::string& units)
{
    if (TakeProgrammatic(programmatic)) {
        return;
    }
    const std::string name = boost::algorithm::trim_copy(units);
    TakeUnits(name.empty() ? boost::algorithm::trim_copy(programmatic) : name);
}

// Whether the unit is known.
bool TUnit::TakeProgrammatic(const std::string& text)
{
    std::vector<std::string> parts;
    boost::algorithm::split(parts, text, boost::algorithm::is_any_of("*"));
    std::vector<TPower> powers;
    for (std::size_t i = 1; i < parts.size(); ++i) {
        const std::optional<TPower> power = PowerOf(boost::algorithm::trim_copy(parts[i]));
        if (!power) {
            return false;
        }
        powers.push_back(*power);
    }
    const std::string base = boost::algorithm::to_lower_copy(boost::algorithm::trim_copy(parts.front()));
    if (base == "byte") {
        fBytes = Multiply(powers);
        TakeName(fBytes == 1 ? "bytes" : boost::algorithm::trim_copy(text));
        return fBytes > 0;
    }
    const auto known =
        std::find_if(std::begin(kBaseUnits), std::end(kBaseUnits), [&base](const auto& unit) { return base == unit.unit; });
    const char* const prefix = PrefixOf(powers);
    if (known == std::end(kBaseUnits) || prefix == nullptr) {
        return false;
    }
    fName = std::string(prefix) + known->shown;
    fNameOfOne = fName;
    return true;
}

void TUnit::TakeUnits(const std::string& text)
{
    const std::string lower = boost::algorithm::to_lower_copy(text);
    if (lower == "bytes") {
        fBytes = 1;
    }
    const auto known =
        std::find_if(std::begin(kOldUnits), std::end(kOldUnits), [&lower](const auto& unit) { return lower == unit.units; });
    if (known != std::end(kOldUnits)) {
        fName = known->shown;
        fNameOfOne = fName;
    } else if (!text.empty()) {
        TakeName(lower == "bytes" ? lower : text);
    }
}

// A name as a declaration has it, for numbers that are shown as they are.
void TUnit::TakeName(const std::string& name)
{
    fName = InlineText(TCIMValue(name));
    fNameOfOne = InlineText(TCIMValue(SingularOf(name)));
}

std::string TUnit::Describe(const TCIMValue& number) const
{
    if (number.IsNull() || !IsNumber(number.GetType()) || fName.empty()) {
        return std::string();
    }
    const bool isCounted =
        fBytes > 0 && IsUnsigned(number.GetType()) && number.GetUnsigned() <= std::numeric_limits<std::uint64_t>::max() / fBytes;
    if (isCounted) {
        return ReadableBytes(number.GetUnsigned() * fBytes);
    }
    const std::string text = DisplayValue(number);
    return text + " " + (text == "1" || text == "-1" ? fNameOfOne : fName);
}

// From one MiB on, people want the magnitude first, and below it the number. In quarters of the unit, a number is exact with two
// digits.
std::string ReadableBytes(std::uint64_t bytes)
{
    constexpr std::uint64_t kStep = 1024;
    const char* const names[] = {"KiB", "MiB", "GiB", "TiB", "PiB", "EiB"};
    const std::string exact = std::to_string(bytes) + (bytes == 1 ? " byte" : " bytes");
    if (bytes < kStep * kStep) {
        return bytes == 0 || bytes % kStep != 0 ? exact : std::to_string(bytes / kStep) + " KiB";
    }
    std::size_t name = 0;
    std::uint64_t unit = kStep;
    for (; bytes / unit >= kStep; unit *= kStep) {
        ++name;
    }
    const std::uint64_t rest = bytes % unit;
    const auto hundredths = static_cast<std::uint64_t>(static_cast<double>(rest) / static_cast<double>(unit) * 100 + 0.5);
    std::string decimals = hundredths % 100 == 0 ? std::string() : "." + std::to_string(100 + hundredths % 100).substr(1);
    if (!decimals.empty() && decimals.back() == '0') {
        decimals.pop_back();
    }
    const std::string text = std::to_string(bytes / unit + hundredths / 100) + decimals + " " + names[name];
    return rest % (unit / 4) == 0 ? text : text + " (" + exact + ")";
}

}  // namespace NORVZEL20
