#pragma once

#include <cstddef>
#include <map>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "client/comparison/TDifference.h"
#include "client/comparison/TDifferenceCounter.h"
#include "client/findings/TClassFindings.h"
#include "client/findings/TPresencePlaces.h"
#include "client/findings/TShortNames.h"

namespace NORVZEL20 {

/// Groups the differences of one class, which are added in the order of IDifferences.
class TClassCollector {
  public:
    /// Of each finding, at most `most` examples are kept. `names` must outlive this, and so must `inventories`, those of the
    /// report.
    TClassCollector(const std::vector<TInventory>& inventories, TShortNames& names, const std::string& className, std::size_t most);

    const std::string& GetClassName() const { return fFindings.className; }

    void Add(const TDifference& difference);
    /// The findings. Call it once, at the end.
    TClassFindings Take();

  private:
    // A change by the text that says all of it: 128 bits of its hashes.
    using TDigest = std::pair<std::size_t, std::size_t>;
    struct THashOfDigest {
        std::size_t operator()(const TDigest& digest) const { return digest.first; }
    };

    // A distinct change of a property.
    struct TKnown {
        std::size_t instances = 0;
        std::size_t place = kNowhere;  // in TProperty::examples
    };
    static constexpr std::size_t kNowhere = static_cast<std::size_t>(-1);

    // The same of an example, as far as it is counted.
    struct TKept {
        TDigest digest;
        std::size_t instances;
    };

    // The changes of one property in the same inventories.
    struct TProperty {
        std::unordered_map<TDigest, TKnown, THashOfDigest> known;
        std::vector<TChangeFinding> examples;  // the changes that most instances have so far
        std::vector<TKept> kept;               // of the examples
        std::size_t fewest = 0;                // no example has fewer instances
        std::size_t instances = 0;
    };
    using TWhere = std::pair<std::string, std::vector<std::size_t>>;  // the property, and the inventories

    void AddPresence(const TDifference& difference);
    void AddWords(const std::string& property);
    void AddChange(const TDifference& difference, const TValueDifference& change);
    void Keep(TProperty& property, const TDigest& digest, TKnown& known, const TValueDifference& change) const;

    const std::vector<TInventory>& fInventories;
    TShortNames& fNames;
    const std::size_t fMost;
    TClassFindings fFindings;
    TDifferenceCounter fCounter;
    TPresencePlaces<> fPresences;  // in fFindings.presences
    std::map<TWhere, TProperty> fProperties;
};

}  // namespace NORVZEL20
