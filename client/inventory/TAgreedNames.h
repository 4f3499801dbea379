#pragma once

#include <string>
#include <unordered_set>

#include "embedded/store/TInMemClass.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

/// What all inventories are known to declare: classes with their properties, inherited ones too, in one spelling.
///
/// A class that is covered need not be compared with the other inventories. It copies all names, because a spelling may change in
/// place.
/// Threads: as any container.
class TAgreedNames {
  public:
    /// Whether the class and all its properties are among the names, letter for letter. Cost: a look-up for each property.
    bool Covers(const TInMemClass& cls) const;
    /// Every inventory now has the class and its properties. They replace what was known of it.
    void Add(const TInMemClass& cls);
    /// Not every inventory has the class as it is here. Without effect if nothing is known of it.
    void Forget(const TInMemClass& cls);
    /// A property of `cls` is spelled another way in its inventory. If that is not the known spelling, the class is forgotten.
    void Respelled(const TInMemClass& cls, const std::string& property);

  private:
    struct TEntry {
        std::string className;
        std::unordered_set<std::string> properties;
    };

    TNameMap<TEntry> fClasses;
};

}  // namespace NORVZEL20
