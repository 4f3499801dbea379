#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace NORVZEL20 {

/// A CIM datetime: a point in time with its UTC offset, or an interval (DSP0004, 5.2.4 "Datetime type").
///
/// Fields, and single digits of the microseconds, may be asterisks: not known. A value type of 16 bytes, no allocation.
class TCIMDateTime {
  public:
    /// The point in time 1970-01-01 00:00 UTC.
    TCIMDateTime() noexcept = default;

    /// Reads the 25 characters "yyyymmddhhmmss.mmmmmmsutc" or "ddddddddhhmmss.mmmmmm:000". Returns false, and leaves `result` as
    /// it is, for any other length, form or range (month 13, hour 24, second 60, a day that its month lacks).
    static bool Parse(std::string_view text, TCIMDateTime& result) noexcept;

    /// The 25 characters, with the offset and the asterisks it was read with ("-000" comes back as "+000").
    std::string ToText() const;

    bool IsInterval() const noexcept { return fInterval; }

    /// Equal instants (the offset applied) or equal intervals, with asterisks in the same places. An interval never equals a
    /// point in time.
    bool operator==(const TCIMDateTime& other) const noexcept;
    bool operator!=(const TCIMDateTime& other) const noexcept { return !(*this == other); }
    /// The order of instants, or of lengths; points in time stand before intervals.
    bool operator<(const TCIMDateTime& other) const noexcept;

    /// Microseconds since 1970-01-01 00:00 UTC, or of the interval; asterisks count as the least value of their field.
    std::int64_t GetMicroseconds() const noexcept { return fMicroseconds; }
    /// Minutes east of UTC; 0 for an interval.
    std::int16_t GetOffset() const noexcept { return fOffset; }
    /// One bit for each unknown field, from the most significant (bit 0: years or the days of an interval) to the
    /// last digit of the microseconds (bit 11).
    std::uint16_t GetUnknown() const noexcept { return fUnknown; }

  private:
    friend class TValueAccess;

    std::int64_t fMicroseconds = 0;
    std::int16_t fOffset = 0;
    std::uint16_t fUnknown = 0;
    bool fInterval = false;
};

}  // namespace NORVZEL20
