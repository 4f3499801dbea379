#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "host/Export.h"

namespace NORVZEL20 {

/// A CIM datetime: a point in time with its UTC offset, or an interval (DSP0004, 5.2.4 "Datetime type").
///
/// Asterisks stand for a field, or for single digits of the microseconds, that is not known. A value type of 16 bytes; nothing is
/// allocated.
class CIMDELTA_EXPORT TCIMDateTime {
  public:
    /// The point in time 1970-01-01 00:00 UTC.
    TCIMDateTime() noexcept = default;

    /// Reads the 25 characters "yyyymmddhhmmss.mmmmmmsutc" or "ddddddddhhmmss.mmmmmm:000". Returns false, and leaves `result` as
    /// it is, for any other text and for a field out of range (month 13, hour 24, second 60, February 30).
    static bool Parse(std::string_view text, TCIMDateTime& result) noexcept;

    /// The 25 characters, with the offset and the asterisks that were read. "-000" is written as "+000".
    std::string ToText() const;

    /// The same datetime at the offset next to UTC that can express it. Equal datetimes become the same text.
    ///
    /// The offset is +000, with two exceptions. Asterisks stand for what is not known at one offset: the hours of a day of which
    /// only the date is known lie on two dates of UTC. And years end at 0000 and 9999. Then it is the least offset, and of two
    /// such offsets the eastern one, at which the unknown fields are the same. An interval has no offset.
    TCIMDateTime GetCanonical() const noexcept;

    bool IsInterval() const noexcept { return fInterval; }

    /// True for equal instants, with any offsets, and for equal intervals, if both have asterisks in the same places. An interval
    /// never equals a point in time.
    bool operator==(const TCIMDateTime& other) const noexcept;
    bool operator!=(const TCIMDateTime& other) const noexcept { return !(*this == other); }
    /// Orders points in time by instant and intervals by length. Every point in time comes before every interval.
    bool operator<(const TCIMDateTime& other) const noexcept;

    /// Microseconds since 1970-01-01 00:00 UTC, or of the interval; an unknown field counts as the least value it can have.
    std::int64_t GetMicroseconds() const noexcept { return fMicroseconds; }
    /// Minutes east of UTC; 0 for an interval.
    std::int16_t GetOffset() const noexcept { return fOffset; }
    /// One bit for each unknown field: bit 0 for the years (or the days of an interval), 1 to 5 for month, day, hour, minute and
    /// second, 6 to 11 for the digits of the microseconds.
    std::uint16_t GetUnknown() const noexcept { return fUnknown; }

  private:
    friend class TValueAccess;

    std::int64_t fMicroseconds = 0;
    std::int16_t fOffset = 0;
    std::uint16_t fUnknown = 0;
    bool fInterval = false;
};

}  // namespace NORVZEL20
