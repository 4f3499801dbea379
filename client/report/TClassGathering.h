#pragma once

#include <cstddef>
#include <map>
#include <string>
#include <vector>

#include "client/comparison/TCoverage.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

/// Classes about which the same is said, under one name.
struct TClassGroup {
    std::string top;                                ///< the class whose name the group has
    std::string name;                               ///< for people: "Fan", "Fan and 2 classes below it", "2 classes below Device"
    std::vector<const TCoverage::TClass*> classes;  ///< in ascending order of their names
};

/// Names many classes by few names, those of classes above them.
class TClassGathering {
  public:
    /// `among` are the classes about which something may be said; no class is twice in it. The arguments must outlive this.
    TClassGathering(const TCoverage& coverage, const std::vector<const TCoverage::TClass*>& among);

    /// The groups of the classes `said`, some of those of the constructor, in ascending order of the tops. A group under a class
    /// holds all classes of `among` at and below it, so it is clear which ones are meant. The group is as large
    /// as possible and its top as low as possible. A class that is in no such group is one of its own. Cost: a step for each class
    /// of the trees.
    std::vector<TClassGroup> Gather(const std::vector<const TCoverage::TClass*>& said) const;

  private:
    struct TNode {
        std::string name;
        std::size_t above = 0;   ///< position of the superclass; its own if it has none
        std::size_t own = 0;     ///< 1 if something may be said about the class itself
        std::size_t total = 0;   ///< of how many classes at and below it something may be said
        std::size_t lowest = 0;  ///< the lowest class with the same ones at and below it
    };

    std::size_t Find(const std::string& name, const TCoverage& coverage);
    std::vector<std::size_t> FindTops(const std::vector<const TCoverage::TClass*>& said) const;

    std::vector<TNode> fNodes;  ///< a class stands behind its superclass
    std::map<std::string, std::size_t, TNameText::TLess> fPositions;
};

}  // namespace NORVZEL20
