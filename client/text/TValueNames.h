#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Names for integers, as the qualifiers ValueMap and Values of a property give them (DSP0004, 5.6.3).
class TValueNames {
  public:
    /// No names.
    TValueNames() = default;

    /// Each element of `map` names the values of the element of `names` at its position: a number, a range (`5..10`, `..4`,
    /// `11..`), or `..` for all that no other element names. Without a map, names are those of 0, 1, 2 and so on. Elements that are
    /// neither are passed over.
    TValueNames(const std::vector<std::string>& map, const std::vector<std::string>& names);

    /// The name of an integer; null if there is none. Valid while this lives.
    const std::string* Find(const TCIMValue& integer) const;

  private:
    // Any integer of CIM.
    struct TInteger {
        bool isNegative;
        std::uint64_t magnitude;

        bool operator<(const TInteger& other) const;
    };

    struct TRange {
        std::optional<TInteger> first;  // without one, from the least
        std::optional<TInteger> last;   // without one, to the greatest
        std::string name;

        bool Holds(const TInteger& integer) const;
        bool IsOne() const { return first && last && !(*first < *last); }
    };

    static std::optional<TInteger> Parse(const std::string& text);
    void Add(const std::string& values, const std::string& name);

    std::vector<TRange> fRanges;  // single numbers first
    std::optional<std::string> fOthers;
};

}  // namespace NORVZEL20
