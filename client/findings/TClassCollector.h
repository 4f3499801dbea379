#pragma once

#include <cstddef>
#include <map>
#include <set>
#include <string>
#include <unordered_map>
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
    // The changes of one property, each by the text that says all of it.
    struct TProperty {
        std::vector<TChangeFinding> changes;
        std::unordered_map<std::string, std::size_t> positions;  // in `changes`
        std::set<std::size_t> inventories;
        std::size_t instances = 0;
    };

    void AddPresence(const TDifference& difference);
    void AddChange(const TDifference& difference, const TValueDifference& change);

    TShortNames& fNames;
    TClassFindings fFindings;
    std::map<std::string, TProperty> fProperties;
    std::string fInstance;  // of the last changed value
};

}  // namespace NORVZEL20
