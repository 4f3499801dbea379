#include "client/text/ReadableTime.h"

#include <algorithm>

namespace NORVZEL20 {

namespace {

constexpr std::size_t kLength = 25;
constexpr std::size_t kFraction = 15;  // where the six digits behind the dot begin
constexpr std::size_t kSign = 21;      // where the sign of the offset stands, or the colon of an interval
constexpr std::size_t kMinutesOfHour = 60;

bool AreDigits(std::string_view text)
{
    return std::all_of(text.begin(), text.end(), [](char c) { return c >= '0' && c <= '9'; });
}

std::string Time(std::string_view digits)
{
    return std::string(digits.substr(0, 2)) + ":" + std::string(digits.substr(2, 2)) + ":" + std::string(digits.substr(4, 2));
}

// ".5" of "500000"; empty for zeros.
std::string Fraction(std::string_view digits)
{
    const std::size_t last = digits.find_last_not_of('0');
    return last == std::string_view::npos ? std::string() : "." + std::string(digits.substr(0, last + 1));
}

std::string TwoDigits(std::size_t number)
{
    return (number < 10 ? "0" : "") + std::to_string(number);
}

std::string Offset(std::string_view text)
{
    const std::size_t minutes = std::stoul(std::string(text.substr(1)));
    return std::string(text.substr(0, 1)) + TwoDigits(minutes / kMinutesOfHour) + ":" + TwoDigits(minutes % kMinutesOfHour);
}

}  // namespace

std::string ReadableTime(std::string_view text)
{
    if (text.size() != kLength || !AreDigits(text.substr(0, kFraction - 1)) || text[kFraction - 1] != '.' ||
        !AreDigits(text.substr(kFraction, kSign - kFraction)) || !AreDigits(text.substr(kSign + 1))) {
        return std::string(text);
    }
    const std::string fraction = Fraction(text.substr(kFraction, kSign - kFraction));
    const std::string time = Time(text.substr(8, 6)) + fraction;
    if (text[kSign] == ':') {
        return std::to_string(std::stoul(std::string(text.substr(0, 8)))) + " d " + time;
    }
    return std::string(text.substr(0, 4)) + "-" + std::string(text.substr(4, 2)) + "-" + std::string(text.substr(6, 2)) + " " +
           time + " " + Offset(text.substr(kSign));
}

}  // namespace NORVZEL20
