#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventory.h"
#include "client/inventory/TSchemaNote.h"

namespace NORVZEL20 {

/// Declares in each inventory what the others declare, so that inventories of different schemas can be compared.
///
/// Inventory by inventory and class by class, superclasses first: a class or property that another one lacks is declared there; a
/// name in another letter case gets the spelling of the first inventory that has it, in references too. Instances are neither made
/// nor removed; a property declared late is null. Keys and types that differ cannot be reconciled and are only noted.
class TSchemaCompletion {
  public:
    /// `inventories` must outlive this.
    explicit TSchemaCompletion(std::vector<TInventory>& inventories) : fInventories(inventories) {}

    /// What was done and found, by the inventory whose declarations were taken, then by class; the order in the files does not
    /// show. Errors: TClientError where a class or property cannot be declared in an inventory because one above or below it there
    /// has a property of another type, or because it would go beyond TSchemaLimits, or where two instances are the same once their
    /// keys are spelled alike.
    std::vector<TSchemaNote> Run();

  private:
    void SpreadWithinLimits(std::size_t source, const TInMemClass& cls, std::size_t target);
    void Spread(std::size_t source, const TInMemClass& cls, std::size_t target);
    void Declare(std::size_t source, const TInMemClass& cls, std::size_t target);
    void DeclareProperty(std::size_t source, const TInMemPropertyDecl& property, std::size_t target, TInMemClass& there);
    void Respell(std::size_t source, const TInMemClass& cls, std::size_t target);
    void Note(TSchemaNote::EKind kind, std::size_t target, std::size_t source, const std::string& className,
              const std::string& property, const std::string& before = std::string());
    void AdaptReferences();
    void SortNotes();

    std::vector<TInventory>& fInventories;
    std::vector<TSchemaNote> fNotes;
};

}  // namespace NORVZEL20
