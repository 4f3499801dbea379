#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>
#include <string_view>
#include <vector>

#include "embedded/store/THashIndex.h"
#include "embedded/store/TInMemPropertyDecl.h"
#include "embedded/store/TLikelySlots.h"
#include "embedded/value/TNameText.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// The properties of a class: the slot in which its instances keep each one, the order of declaration, and the keys.
///
/// A slot stays the same as long as the layout lives. Slots are not in order of declaration: use GetOrder for that.
/// Changes come in two steps. Reserve, on this layout and on those that inherit from it, is the only one that may fail; Update and
/// TakeIn cannot fail after it. The caller that changes a layout calls them for each layout below it, superclasses first.
/// Threads: as the namespace of the class.
class CIMDELTA_EXPORT TInMemLayout {
  public:
    static constexpr std::uint32_t kNoSlot = 0xffffffff;

    /// `super` is the layout of the superclass, null for none; it must outlive this one. Takes over all that it has.
    explicit TInMemLayout(const TInMemLayout* super);
    TInMemLayout(const TInMemLayout&) = delete;
    TInMemLayout& operator=(const TInMemLayout&) = delete;

    /// kNoSlot if there is no such property. Letter case does not count. Cost: constant on average.
    std::uint32_t FindSlot(std::string_view name) const noexcept
    {
        const std::uint32_t likely = fLikelySlots.Guess(name);
        if (likely == TLikelySlots::kNone) {
            return SearchSlot(name);
        }
        return IsNamed(likely, name) ? likely : SearchUnlikelySlot(name);
    }
    /// All slots ever given, those of removed properties included.
    std::uint32_t GetSlotCount() const noexcept { return static_cast<std::uint32_t>(fSlots.size()); }
    const TInMemPropertyDecl& GetDecl(std::uint32_t slot) const noexcept { return *fSlots[slot]; }
    const boost::shared_ptr<TInMemPropertyDecl>& GetSharedDecl(std::uint32_t slot) const noexcept { return fSlots[slot]; }
    /// The slots of all properties in order of declaration, inherited ones first.
    const std::vector<std::uint32_t>& GetOrder() const noexcept { return fOrder; }
    /// The slots of the keys, in that order.
    const std::vector<std::uint32_t>& GetKeys() const noexcept { return fKeys; }
    /// Changes whenever GetKeys does.
    std::uint32_t GetKeyVersion() const noexcept { return fKeyVersion; }
    /// What the class itself declares or overrides, in order.
    const std::vector<boost::shared_ptr<TInMemPropertyDecl>>& GetOwnDecls() const noexcept { return fOwn; }
    /// The declaration that counts for this class, its own or an inherited one; null if there is none.
    boost::shared_ptr<TInMemPropertyDecl> FindDecl(std::string_view name) const;

    /// Takes over what has changed in the superclass since the last time. A class that is not declared is not kept up to date and
    /// needs this when it is declared. Errors: std::bad_alloc.
    void CatchUp();
    /// Makes room for one more property, which may be a key.
    void Reserve();
    /// Adds a declaration to this class. One of that name that is inherited is overridden by it and keeps its place. Call Reserve
    /// first. Errors: std::bad_alloc, and then nothing has changed.
    void AddOwn(const boost::shared_ptr<TInMemPropertyDecl>& decl);
    /// Takes out a declaration of the class itself. What it overrode counts again.
    void RemoveOwn(const boost::shared_ptr<TInMemPropertyDecl>& decl);
    /// Takes over a declaration that has been added above. One whose name is new here comes at `position` of the order.
    void TakeIn(const boost::shared_ptr<TInMemPropertyDecl>& decl, std::size_t position);
    /// Takes over a change of the property `name` here or above: of its qualifiers, or that it was removed.
    void Update(std::string_view name);

  private:
    bool IsNamed(std::uint32_t slot, std::string_view name) const noexcept
    {
        return TNameText::HasSameSpelling(fSlots[slot].get()->GetName(), name);
    }
    std::uint32_t SearchUnlikelySlot(std::string_view name) const noexcept;
    std::uint32_t SearchSlot(std::string_view name) const noexcept;
    void Insert(const boost::shared_ptr<TInMemPropertyDecl>& decl, std::size_t position);
    void Resolve(std::string_view name);
    void Append(const boost::shared_ptr<TInMemPropertyDecl>& decl);
    void Rearrange();
    void UpdateOrder();
    void UpdateKeys();

    const TInMemLayout* fSuper;
    std::vector<boost::shared_ptr<TInMemPropertyDecl>> fOwn;
    std::vector<boost::shared_ptr<TInMemPropertyDecl>> fSlots;  // that of a removed property keeps its declaration
    THashIndex fSlotIndex;                                      // slots by the names of their declarations
    TLikelySlots fLikelySlots;                                  // the same, asked first
    std::vector<std::uint32_t> fOrder;
    std::vector<std::uint32_t> fKeys;
    std::uint32_t fVersion = 0;       // counts the changes of slots, order and keys
    std::uint32_t fSuperVersion = 0;  // the superclass's count when its slots were last taken over
    std::uint32_t fKeyVersion = 0;
};

}  // namespace NORVZEL20
