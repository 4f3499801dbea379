#pragma once

#include <string>

#include "client/text/TUnit.h"
#include "client/text/TValueNames.h"
#include "host/ICIMPropertyDecl.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// The values of one property as people write them: numbers with the names or the unit that its declaration gives them, datetimes
/// with dashes and colons.
class TValueWords {
  public:
    /// Of a property whose declaration is not known.
    TValueWords() = default;
    /// Reads the qualifiers ValueMap, Values, PUnit and Units.
    explicit TValueWords(const ICIMPropertyDecl& declaration);

    /// `3 Degraded`, `512 MiB`, `2024-01-31 10:00:00 +01:00`; of an array `{2 OK, 3 Degraded}`. Different values of one type have
    /// different texts. Empty if the value is to be written as it is. A name with a mark that lines of a report use is in quotes.
    std::string Describe(const TCIMValue& value) const;

  private:
    std::string DescribeArray(const TCIMValue& value) const;

    TValueNames fNames;
    TUnit fUnit;
};

}  // namespace NORVZEL20
