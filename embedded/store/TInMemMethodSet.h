#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string_view>
#include <vector>

#include "embedded/store/TInMemMethodDecl.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// The methods of one class: its own, and those that it inherits. Letter case of names does not count.
///
/// A method overrides the inherited one of its name and inherits qualifiers from it. When a method is added to a class or removed
/// from it, call Inherit on the sets of all classes below.
class CIMDELTA_EXPORT TInMemMethodSet {
  public:
    /// `parent` is the set of the superclass, null for none; it must outlive this one.
    explicit TInMemMethodSet(const TInMemMethodSet* parent) noexcept : fParent(parent) {}
    TInMemMethodSet(const TInMemMethodSet&) = delete;
    TInMemMethodSet& operator=(const TInMemMethodSet&) = delete;

    /// The method of that name, own or inherited; null if there is none.
    boost::shared_ptr<TInMemMethodDecl> Find(std::string_view name) const;
    /// What the class itself declares or overrides, in order.
    const std::vector<boost::shared_ptr<TInMemMethodDecl>>& GetOwn() const noexcept { return fOwn; }
    /// All methods, each once, in the order in which they were first declared, those of superclasses first.
    std::vector<boost::shared_ptr<TInMemMethodDecl>> GetAll() const;

    /// False if the class itself has one of that name.
    bool Add(const boost::shared_ptr<TInMemMethodDecl>& method);
    /// False if the class itself does not have it.
    bool Remove(const boost::shared_ptr<TInMemMethodDecl>& method);
    /// Finds anew what an own method of that name overrides; does nothing if there is none.
    void Inherit(std::string_view name);
    /// The same for all own methods.
    void InheritAll();

  private:
    const TInMemMethodSet* fParent;
    std::vector<boost::shared_ptr<TInMemMethodDecl>> fOwn;
};

}  // namespace NORVZEL20
