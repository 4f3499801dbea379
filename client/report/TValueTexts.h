#pragma once

#include <string>

#include "client/comparison/TValueDifference.h"

namespace NORVZEL20 {

/// How the values of one difference are written so that a person sees in what they differ.
///
/// Embedded instances are shown by their properties, or as CIM-XML if two of them would look alike. If the types differ, the type
/// stands before each value, because the values themselves may look alike. An embedded object has a type of its own.
class TValueTexts {
  public:
    /// With `hasReference`, the reference's value counts too.
    TValueTexts(const TValueDifference& difference, bool hasReference);

    /// The text of one of the difference's values.
    std::string Get(const TCIMValue& value) const;

  private:
    bool fWithTypes = false;
    bool fExact = false;
};

}  // namespace NORVZEL20
