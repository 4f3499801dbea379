#pragma once

#include <cstdint>
#include <string>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// The unit of a number, as the qualifiers PUnit and Units of a property name it (DSP0004, 5.6.3 and Annex C).
class TUnit {
  public:
    /// No unit.
    TUnit() = default;

    /// The unit that PUnit names (`byte * 2^10`), or if that is not known, Units (`KiloBytes`). Empty texts are allowed. An unknown
    /// unit is the text of Units, or else that of PUnit.
    TUnit(const std::string& programmatic, const std::string& units);

    /// The number with its unit: `1500 MHz`, `1 Block`; bytes as by ReadableBytes, if they are not negative and fit 64 bits, and
    /// otherwise with the unit as it is written: `-5 byte * 2^10`. Different numbers have different texts. Empty if there is no
    /// unit, and for a value that is no number.
    std::string Describe(const TCIMValue& number) const;

  private:
    bool TakeProgrammatic(const std::string& text);
    void TakeUnits(const std::string& text);
    void TakeName(const std::string& name);

    std::uint64_t fBytes = 0;  // how many bytes the unit is; 0 if it is none of bytes
    std::string fName;         // of numbers that are not counted in bytes
    std::string fNameOfOne;    // the same of a single one
};

/// That many bytes: below one MiB in KiB if these are whole, otherwise as they are, `1500 bytes`; from there on in the largest
/// binary unit, `512 MiB`, with the exact number unless quarters of the unit say it: `7.46 MiB (7823345 bytes)`.
std::string ReadableBytes(std::uint64_t bytes);

}  // namespace NORVZEL20
