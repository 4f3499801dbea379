#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// What was read of one thing: the class of its instance and the values of properties, in no particular order. What is not set
/// becomes NULL. Integers are held with 64 bits and get the type of the declaration when the instance is written.
///
/// Names must be string literals. Texts may be any bytes: they become valid ones (see ValidText).
class TFacts {
  public:
    using TValue = std::pair<const char*, TCIMValue>;

    explicit TFacts(const char* className) : fClassName(className) {}

    /// An empty text stays NULL.
    TFacts& Text(const char* name, std::string_view text);
    /// For keys: an empty text is a value.
    TFacts& Key(const char* name, std::string_view text);
    TFacts& Number(const char* name, std::uint64_t number);
    TFacts& Signed(const char* name, std::int64_t number);
    TFacts& Flag(const char* name, bool flag);
    /// An empty array is a value.
    TFacts& Texts(const char* name, const std::vector<std::string>& texts);
    /// A point in time, in seconds since 1970-01-01 00:00 UTC.
    TFacts& Time(const char* name, std::int64_t seconds);

    const char* GetClassName() const noexcept { return fClassName; }
    const std::vector<TValue>& GetValues() const noexcept { return fValues; }
    /// NULL if it is not set.
    TCIMValue Find(std::string_view name) const;

  private:
    TFacts& Add(const char* name, TCIMValue value);

    const char* fClassName;
    std::vector<TValue> fValues;
};

}  // namespace NORVZEL20
