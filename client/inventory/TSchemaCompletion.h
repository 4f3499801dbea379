#pragma once

#include <string>
#include <vector>

#include "client/inventory/TAgreedNames.h"
#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"

namespace NORVZEL20 {

/// Declares in each inventory what the others declare. Then inventories with different schemas can be compared.
///
/// A class or property that an inventory lacks is declared there. A name that differs in letter case gets the spelling of the first
/// inventory that has it, in stored references too. Instances are neither made nor removed; a property that is declared late is
/// null in all of them. Keys and types that differ are left alone.
class TSchemaCompletion {
  public:
    /// `inventories` must outlive this.
    explicit TSchemaCompletion(std::vector<TInventory>& inventories) : fInventories(inventories) {}

    /// Returns what was done, in any order.
    /// Errors: TClientError if a class or property cannot be declared because a class above or below it has the property with
    /// another type, if the schema would exceed TSchemaLimits, or if two instances have the same path once their references are
    /// spelled alike. The inventories may be changed by then.
    /// Cost: a look-up for each property of each class of each inventory; and for each class that gives the others anything, one
    /// for each of its properties in each of them.
    std::vector<TSchemaNote> Run();
    /// How many times Run held a class of one inventory against that of another one.
    std::size_t CountComparisons() const noexcept { return fComparisons; }

  private:
    void SpellCollectionTimes();
    void SpreadToAll(std::size_t source, const TInMemClass& cls);
    bool Agrees(std::size_t source, const TInMemClass& cls, std::size_t target) const;
    void SpreadWithinLimits(std::size_t source, const TInMemClass& cls, std::size_t target);
    void Spread(std::size_t source, const TInMemClass& cls, std::size_t target);
    void Declare(std::size_t source, const TInMemClass& cls, std::size_t target);
    void DeclareProperty(std::size_t source, const TInMemPropertyDecl& property, std::size_t target, TInMemClass& there);
    void Respell(std::size_t source, const TInMemClass& cls, std::size_t target);
    void ForgetRespelled(const TInMemClass& cls, const std::string& property);
    [[noreturn]] void Refuse(std::size_t source, const std::string& element, std::size_t target, const std::string& reason) const;
    void Note(TSchemaNote::EKind kind, std::size_t target, std::size_t source, const std::string& className,
              const std::string& property, const std::string& before = std::string());
    void AdaptReferences();

    std::vector<TInventory>& fInventories;
    std::vector<TSchemaNote> fNotes;
    TAgreedNames fAgreed;
    std::size_t fComparisons = 0;
};

}  // namespace NORVZEL20
