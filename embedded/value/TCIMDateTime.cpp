// Datetimes have 25 characters:
//
//     yyyymmddhhmmss.mmmmmmsutc    a point in time: sign and three digits are the minutes east of UTC
//     ddddddddhhmmss.mmmmmm:000    an interval
//
// A field that is not known consists of asterisks; of the microseconds, any digit may be one. A datetime is held as microseconds
// in UTC since 1970 (or in the interval), the offset, and one bit for each unknown field. An unknown field counts as its least
// value. Two datetimes are equal if their microseconds and their bits are. Writing goes the way back and then puts the asterisks
// over the unknown fields.
//
// The canonical offset depends only on what equality compares, so equal datetimes have the same canonical text: it is the first of
// 0, 1, -1, 2, -2, ... at which every unknown field has its least value and the year has four digits. The offset that was read
// fits, and it is less than a day. So the local time lies on the day of UTC or on one of its neighbours, and on each of the three
// days it is the fitting minute that is next to UTC.
//
// Days are counted in years that begin on March 1, which puts the leap day at the end of a year, and in eras of 400 such years
// with 146,097 days each. From the beginning of era 0 to 1970-01-01 there are 719,468 days.

#include "host/TCIMDateTime.h"

#include <algorithm>
#include <array>
#include <cstdlib>

namespace NORVZEL20 {

namespace {

constexpr std::size_t kLength = 25;
constexpr std::size_t kPoint = 14;         // the position of the decimal point
constexpr std::size_t kMicroseconds = 15;  // the position of the first digit behind it
constexpr std::size_t kSign = 21;          // the position of the sign, or of an interval's colon
constexpr unsigned int kFirstMicrosecondBit = 6;
constexpr std::int64_t kSecond = 1000000;
constexpr std::int64_t kMinute = 60 * kSecond;
constexpr std::int64_t kHour = 60 * kMinute;
constexpr std::int64_t kDay = 24 * kHour;
constexpr std::int64_t kMinutesOfHour = 60;
constexpr std::int64_t kMinutesOfDay = 24 * kMinutesOfHour;

/// A field of the text: its place, its bit if it is unknown, and its range.
struct TField {
    std::size_t start;
    std::size_t length;
    unsigned int bit;
    std::int64_t least;
    std::int64_t greatest;
};

constexpr std::array<TField, 6> kTimestampFields{
    {{0, 4, 0, 0, 9999}, {4, 2, 1, 1, 12}, {6, 2, 2, 1, 31}, {8, 2, 3, 0, 23}, {10, 2, 4, 0, 59}, {12, 2, 5, 0, 59}}};
constexpr std::array<TField, 4> kIntervalFields{{{0, 8, 0, 0, 99999999}, {8, 2, 3, 0, 23}, {10, 2, 4, 0, 59}, {12, 2, 5, 0, 59}}};

bool ReadDigits(std::string_view digits, std::int64_t& number) noexcept
{
    number = 0;
    for (const char c : digits) {
        if (c < '0' || c > '9') {
            return false;
        }
        number = number * 10 + (c - '0');
    }
    return true;
}

/// Sets the field's bit in `unknown` if it consists of asterisks.
bool ReadField(std::string_view text, const TField& field, std::int64_t& number, std::uint16_t& unknown) noexcept
{
    const std::string_view digits = text.substr(field.start, field.length);
    if (digits.find_first_not_of('*') == std::string_view::npos) {
        unknown = static_cast<std::uint16_t>(unknown | (1u << field.bit));
        number = field.least;
        return true;
    }
    return ReadDigits(digits, number) && number >= field.least && number <= field.greatest;
}

bool ReadMicroseconds(std::string_view text, std::int64_t& number, std::uint16_t& unknown) noexcept
{
    number = 0;
    for (unsigned int i = 0; i < 6; ++i) {
        const char c = text[kMicroseconds + i];
        if (c == '*') {
            unknown = static_cast<std::uint16_t>(unknown | (1u << (kFirstMicrosecondBit + i)));
        } else if (c < '0' || c > '9') {
            return false;
        }
        number = number * 10 + (c == '*' ? 0 : c - '0');
    }
    return true;
}

bool IsLeapYear(std::int64_t year) noexcept
{
    return year % 4 == 0 && (year % 100 != 0 || year % 400 == 0);
}

std::int64_t GetDaysOfMonth(std::int64_t year, std::int64_t month) noexcept
{
    if (month == 2) {
        return IsLeapYear(year) ? 29 : 28;
    }
    return month == 4 || month == 6 || month == 9 || month == 11 ? 30 : 31;
}

/// The days from 1970-01-01 to a date of the Gregorian calendar; negative for an earlier date.
std::int64_t GetDays(std::int64_t year, std::int64_t month, std::int64_t day) noexcept
{
    year -= month <= 2 ? 1 : 0;
    const std::int64_t era = (year >= 0 ? year : year - 399) / 400;
    const std::int64_t yearOfEra = year - era * 400;
    // From March on, five months have 153 days, again and again: 31, 30, 31, 30, 31.
    const std::int64_t dayOfYear = (153 * (month + (month > 2 ? -3 : 9)) + 2) / 5 + day - 1;
    return era * 146097 + yearOfEra * 365 + yearOfEra / 4 - yearOfEra / 100 + dayOfYear - 719468;
}

struct TDate {
    std::int64_t year;
    std::int64_t month;
    std::int64_t day;
};

/// The inverse of GetDays.
TDate GetDate(std::int64_t days) noexcept
{
    days += 719468;
    const std::int64_t era = (days >= 0 ? days : days - 146096) / 146097;
    const std::int64_t dayOfEra = days - era * 146097;
    const std::int64_t yearOfEra = (dayOfEra - dayOfEra / 1460 + dayOfEra / 36524 - dayOfEra / 146096) / 365;
    const std::int64_t dayOfYear = dayOfEra - (365 * yearOfEra + yearOfEra / 4 - yearOfEra / 100);
    const std::int64_t shifted = (5 * dayOfYear + 2) / 153;
    const std::int64_t month = shifted + (shifted < 10 ? 3 : -9);
    return {yearOfEra + era * 400 + (month <= 2 ? 1 : 0), month, dayOfYear - (153 * shifted + 2) / 5 + 1};
}

struct TDays {
    std::int64_t days;
    std::int64_t rest;  // microseconds of the day, never negative
};

TDays GetWholeDays(std::int64_t microseconds) noexcept
{
    // Before 1970 the division rounds up, but a day begins at the earlier midnight.
    const bool isBefore = microseconds % kDay < 0;
    return {microseconds / kDay - (isBefore ? 1 : 0), microseconds % kDay + (isBefore ? kDay : 0)};
}

bool IsUnknown(const TField& field, unsigned int unknown) noexcept
{
    return (unknown & (1u << field.bit)) != 0;
}

/// Whether the year has four digits and the unknown ones of year, month and day have their least value.
bool IsDateExpressible(std::int64_t days, unsigned int unknown) noexcept
{
    const TDate date = GetDate(days);
    const std::array<std::int64_t, 3> values{date.year, date.month, date.day};
    for (std::size_t i = 0; i < values.size(); ++i) {
        const TField& field = kTimestampFields[i];
        if (IsUnknown(field, unknown) && values[i] != field.least) {
            return false;
        }
    }
    return date.year >= kTimestampFields[0].least && date.year <= kTimestampFields[0].greatest;
}

/// The minute of a day next to `minute`, which may be on another day, at which the unknown ones of hour and minute are 0. Of two
/// that are equally near it is the later one.
std::int64_t GetNearestMinute(std::int64_t minute, unsigned int unknown) noexcept
{
    const std::int64_t step = IsUnknown(kTimestampFields[4], unknown) ? kMinutesOfHour : 1;
    const std::int64_t end = IsUnknown(kTimestampFields[3], unknown) ? kMinutesOfHour : kMinutesOfDay;
    return std::clamp<std::int64_t>((minute + step / 2) / step * step, 0, end - step);
}

/// The offset next to UTC at which the point in time can be written with asterisks over the fields of `unknown`; of two such
/// offsets the eastern one. No offset changes the seconds.
std::int64_t FindCanonicalOffset(std::int64_t microseconds, unsigned int unknown) noexcept
{
    const TDays time = GetWholeDays(microseconds);
    const std::int64_t minute = time.rest / kMinute;
    std::int64_t best = kMinutesOfDay;
    for (const std::int64_t day : {0, 1, -1}) {
        const std::int64_t sought = minute - day * kMinutesOfDay;
        const std::int64_t offset = GetNearestMinute(sought, unknown) - sought;
        const bool isNearer = std::abs(offset) < std::abs(best) || offset == std::abs(best);
        if (isNearer && IsDateExpressible(time.days + day, unknown)) {
            best = offset;
        }
    }
    return best;
}

/// Adds the interval to `microseconds`, which has its fraction of a second already. ReadTimestamp does the same.
bool ReadInterval(std::string_view text, std::int64_t& microseconds, std::uint16_t& unknown) noexcept
{
    std::array<std::int64_t, kIntervalFields.size()> part{};
    for (std::size_t i = 0; i < part.size(); ++i) {
        if (!ReadField(text, kIntervalFields[i], part[i], unknown)) {
            return false;
        }
    }
    microseconds += part[0] * kDay + part[1] * kHour + part[2] * kMinute + part[3] * kSecond;
    return text.substr(kSign + 1) == "000";
}

bool ReadTimestamp(std::string_view text, std::int64_t& microseconds, std::uint16_t& unknown, std::int16_t& offset) noexcept
{
    std::array<std::int64_t, kTimestampFields.size()> part{};
    for (std::size_t i = 0; i < part.size(); ++i) {
        if (!ReadField(text, kTimestampFields[i], part[i], unknown)) {
            return false;
        }
    }
    std::int64_t minutes = 0;
    if (part[2] > GetDaysOfMonth(part[0], part[1]) || !ReadDigits(text.substr(kSign + 1), minutes)) {
        return false;
    }
    offset = static_cast<std::int16_t>(text[kSign] == '-' ? -minutes : minutes);
    microseconds +=
        GetDays(part[0], part[1], part[2]) * kDay + part[3] * kHour + part[4] * kMinute + part[5] * kSecond - offset * kMinute;
    return true;
}

void WriteDigits(char* to, std::size_t length, std::int64_t number) noexcept
{
    for (std::size_t i = length; i-- > 0; number /= 10) {
        to[i] = static_cast<char>('0' + number % 10);
    }
}

void WriteDate(char* to, std::int64_t days) noexcept
{
    const TDate date = GetDate(days);
    WriteDigits(to, 4, date.year);
    WriteDigits(to + 4, 2, date.month);
    WriteDigits(to + 6, 2, date.day);
}

template <class TFields>
void WriteAsterisks(char* to, const TFields& fields, unsigned int unknown) noexcept
{
    for (const TField& field : fields) {
        for (std::size_t i = 0; IsUnknown(field, unknown) && i < field.length; ++i) {
            to[field.start + i] = '*';
        }
    }
    for (unsigned int i = 0; i < 6; ++i) {
        if ((unknown & (1u << (kFirstMicrosecondBit + i))) != 0) {
            to[kMicroseconds + i] = '*';
        }
    }
}

}  // namespace

bool TCIMDateTime::Parse(std::string_view text, TCIMDateTime& result) noexcept
{
    if (text.size() != kLength || text[kPoint] != '.') {
        return false;
    }
    TCIMDateTime parsed;
    parsed.fInterval = text[kSign] == ':';
    if (!parsed.fInterval && text[kSign] != '+' && text[kSign] != '-') {
        return false;
    }
    const bool isRead = ReadMicroseconds(text, parsed.fMicroseconds, parsed.fUnknown) &&
                        (parsed.fInterval ? ReadInterval(text, parsed.fMicroseconds, parsed.fUnknown)
                                          : ReadTimestamp(text, parsed.fMicroseconds, parsed.fUnknown, parsed.fOffset));
    if (isRead) {
        result = parsed;
    }
    return isRead;
}

TCIMDateTime TCIMDateTime::GetCanonical() const noexcept
{
    TCIMDateTime canonical = *this;
    if (fOffset == 0) {
        return canonical;
    }
    canonical.fOffset = static_cast<std::int16_t>(FindCanonicalOffset(fMicroseconds, fUnknown));
    return canonical;
}

std::string TCIMDateTime::ToText() const
{
    const auto [days, rest] = GetWholeDays(fMicroseconds + fOffset * kMinute);
    std::string text(kLength, '.');
    WriteDigits(&text[8], 2, rest / kHour);
    WriteDigits(&text[10], 2, rest % kHour / kMinute);
    WriteDigits(&text[12], 2, rest % kMinute / kSecond);
    WriteDigits(&text[kMicroseconds], 6, rest % kSecond);
    WriteDigits(&text[kSign + 1], 3, std::abs(static_cast<int>(fOffset)));
    if (fInterval) {
        text[kSign] = ':';
        WriteDigits(&text[0], 8, days);
        WriteAsterisks(&text[0], kIntervalFields, fUnknown);
    } else {
        text[kSign] = fOffset < 0 ? '-' : '+';
        WriteDate(&text[0], days);
        WriteAsterisks(&text[0], kTimestampFields, fUnknown);
    }
    return text;
}

bool TCIMDateTime::operator==(const TCIMDateTime& other) const noexcept
{
    return fMicroseconds == other.fMicroseconds && fUnknown == other.fUnknown && fInterval == other.fInterval;
}

bool TCIMDateTime::operator<(const TCIMDateTime& other) const noexcept
{
    if (fInterval != other.fInterval) {
        return other.fInterval;
    }
    return fMicroseconds != other.fMicroseconds ? fMicroseconds < other.fMicroseconds : fUnknown < other.fUnknown;
}

}  // namespace NORVZEL20
