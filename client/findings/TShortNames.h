#pragma once

#include <map>
#include <string>
#include <utility>
#include <vector>

#include "client/comparison/TDifference.h"
#include "client/findings/TDistinctKeys.h"
#include "client/inventory/TInventory.h"

namespace NORVZEL20 {

/// Short names for instances: the values of the keys that tell them apart.
///
/// A key is left out if it has the same value in every instance of the class, in every inventory; references in keys are shortened
/// likewise. If one key tells all of them apart (see FindTellingKey), the others are left out too. No two instances of a class get
/// the same name, unless the rules exclude keys.
class TShortNames {
  public:
    /// The inventories must outlive this. With `areWhole`, no key is left out: the names are as by TDifference::GetKeyText.
    explicit TShortNames(const std::vector<TInventory>& inventories, bool areWhole = false)
        : fInventories(inventories), fAreWhole(areWhole)
    {}

    /// The name of the instance of a difference: `eth0` if one key is left and is text, otherwise `Bus=1,Unit=2`. In brackets what
    /// there is to say of an instance without a key. Cost: for a new class, that of a TDistinctKeys, and of FindTellingKey if that
    /// leaves several keys.
    std::string Of(const TDifference& difference);

  private:
    using TKeys = std::vector<std::pair<std::string, TCIMValue>>;

    const TDistinctKeys& Distinct(const std::string& className);
    const std::string& TellingKey(const std::string& className, const TKeys& left);
    TKeys KeysLeft(const std::string& className, const TKeys& keys);
    std::string Join(const std::string& className, const TKeys& left);
    std::string Text(const TDistinctKeys& distinct, const std::string& key, const TCIMValue& value);

    const std::vector<TInventory>& fInventories;
    const bool fAreWhole;
    std::map<std::string, TDistinctKeys> fClasses;
    std::map<std::string, std::string> fTellingKeys;  // by class
};

}  // namespace NORVZEL20
