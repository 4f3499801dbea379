#include "tests/engine/NaiveTime.h"

#include <cstdio>
#include <ctime>

namespace NORVZEL20 {

namespace {

// What an asterisk stands for in each place of year, month, day, hour, minute and second.
const std::string kLeast = "00000101000000";

std::time_t SecondsOf(const std::string& digits)
{
    std::tm fields{};
    std::sscanf(digits.c_str(), "%4d%2d%2d%2d%2d%2d", &fields.tm_year, &fields.tm_mon, &fields.tm_mday, &fields.tm_hour,
                &fields.tm_min, &fields.tm_sec);
    fields.tm_year -= 1900;
    fields.tm_mon -= 1;
    return timegm(&fields);
}

/// The fourteen digits of the local time with the asterisks of `pattern` over them; empty if they would hide something.
std::string DigitsOf(std::time_t local, const std::string& pattern)
{
    std::tm fields{};
    gmtime_r(&local, &fields);
    char buffer[80];
    std::snprintf(buffer, sizeof buffer, "%04d%02d%02d%02d%02d%02d", fields.tm_year + 1900, fields.tm_mon + 1, fields.tm_mday,
                  fields.tm_hour, fields.tm_min, fields.tm_sec);
    std::string digits = buffer;
    if (digits.size() != kLeast.size()) {
        return "";
    }
    for (std::size_t i = 0; i < digits.size(); ++i) {
        if (pattern[i] == '*' && digits[i] != kLeast[i]) {
            return "";
        }
        digits[i] = pattern[i] == '*' ? '*' : digits[i];
    }
    return digits;
}

}  // namespace

std::string NaiveUtcText(const std::string& text)
{
    if (text[21] == ':') {
        return text;
    }
    std::string known = text.substr(0, kLeast.size());
    for (std::size_t i = 0; i < known.size(); ++i) {
        known[i] = known[i] == '*' ? kLeast[i] : known[i];
    }
    const std::time_t utc = SecondsOf(known) - 60 * std::stoi(text.substr(21));
    for (int minutes = 0; minutes < 1000; ++minutes) {
        for (const char sign : {'+', '-'}) {
            const std::string digits = DigitsOf(utc + (sign == '+' ? 60 : -60) * minutes, text);
            if (!digits.empty()) {
                const std::string offset = std::to_string(1000 + minutes).substr(1);
                return digits + text.substr(14, 7) + sign + offset;
            }
        }
    }
    return "";
}

}  // namespace NORVZEL20
