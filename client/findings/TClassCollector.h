#pragma once

#include <cstddef>
#include <map>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "client/comparison/TDifference.h"
#include "client/findings/TClassFindings.h"
#include "client/findings/TShortNames.h"

namespace NORVZEL20 {

/// Groups the differences of one class, which are added in the order of IDifferences.
class TClassCollector {
  public:
    /// `names` must outlive this.
    TClassCollector(TShortNames& names, const std::string& className);

    const std::string& GetClassName() const { return fFindings.className; }

    void Add(const TDifference& difference);
    /// The findings. Call it once, at the end.
    TClassFindings Take();

  private:
    // The changes of one property in the same inventories, each by the text that says all of it.
    struct TProperty {
        std::vector<TChangeFinding> changes;
        std::unordered_map<std::string, std::size_t> positions;  // in `changes`
        std::size_t instances = 0;
    };
    using TWhere = std::pair<std::string, std::vector<std::size_t>>;  // the property, and the inventories

    void AddPresence(const TDifference& difference);
    void AddChange(const TDifference& difference, const TValueDifference& change);

    TShortNames& fNames;
    TClassFindings fFindings;
    std::map<TWhere, TProperty> fProperties;
    std::string fInstance;  // of the last changed value
};

}  // namespace NORVZEL20
