#pragma once

#include <cstddef>
#include <string>
#include <vector>

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

    /// The text of the reference's value. Only with `hasReference`.
    const std::string& GetReference() const { return fTexts.front(); }
    /// The text of the value of the group at `position` of the difference's others.
    const std::string& GetOther(std::size_t position) const { return fTexts[fTexts.size() - fGroups + position]; }

  private:
    std::vector<std::string> fTexts;  // the reference's if it counts, then the groups'
    std::size_t fGroups;
};

}  // namespace NORVZEL20
