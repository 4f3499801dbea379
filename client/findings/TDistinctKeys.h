#pragma once

#include <map>
#include <string>
#include <vector>

#include "client/inventory/TInventory.h"

namespace NORVZEL20 {

/// What the keys of the instances of one class have in common, in all inventories.
class TDistinctKeys {
  public:
    /// Cost: reads the keys of the class's instances, until nothing is in common any more.
    TDistinctKeys(const std::vector<TInventory>& inventories, const std::string& className);

    /// Whether every instance of the class has this value as that key, and there are several instances.
    bool IsCommon(const std::string& key, const TCIMValue& value) const;
    /// Whether that key of every instance is a reference to one and the same class.
    bool HasCommonClass(const std::string& key) const { return fClasses.count(key) > 0; }

  private:
    void Look(const ICIMInstance& instance);

    std::vector<std::string> fKeys;
    std::map<std::string, TCIMValue> fValues;     // of the keys that have had one value so far
    std::map<std::string, std::string> fClasses;  // of the keys that have been references to one class so far
    std::size_t fInstances = 0;
};

}  // namespace NORVZEL20
