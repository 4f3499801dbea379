#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <string_view>
#include <vector>

#include "host/Export.h"
#include "host/ICIMQualifier.h"

namespace NORVZEL20 {

/// The qualifiers of one element: its own, and those that it inherits from its parent, the element of the superclass.
///
/// A qualifier is inherited if its flavor says so (to the subclass) and the element has none of that name itself.
class CIMDELTA_EXPORT TInMemQualifierSet {
  public:
    /// Letter case does not count.
    static bool IsNamed(const ICIMQualifier& qualifier, std::string_view name);
    /// Whether its value is TRUE.
    static bool HoldsTrue(const ICIMQualifier& qualifier);

    /// Names the set to inherit from; null for none. It must outlive this one.
    void SetParent(const TInMemQualifierSet* parent) noexcept { fParent = parent; }

    /// Adds a qualifier. An own qualifier of the same name is replaced. `qualifier` must not be null.
    void Add(boost::shared_ptr<ICIMQualifier> qualifier);

    /// The qualifier of that name, own or inherited, or null. Letter case does not count.
    boost::shared_ptr<ICIMQualifier> Find(std::string_view name) const;
    /// Own ones in the order they were added, then inherited ones, until the callback returns false.
    void Enumerate(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback) const;

    /// The element's own qualifiers, in the order in which they were added.
    const std::vector<boost::shared_ptr<ICIMQualifier>>& GetOwn() const noexcept { return fOwn; }
    /// The number of qualifiers in this set and its ancestors, including those that are not inherited.
    std::size_t CountAll() const noexcept;
    /// Whether there is one of that name, own or inherited, with the value TRUE.
    bool IsTrue(std::string_view name) const;
    /// Whether the element itself has one of that name with the value TRUE.
    bool IsOwnTrue(std::string_view name) const;
    /// Whether the element or an ancestor has one of that name with the value TRUE, of any flavor.
    bool IsTrueAnywhere(std::string_view name) const;

    /// The element's own one of that name, or null.
    boost::shared_ptr<ICIMQualifier> FindOwn(std::string_view name) const;

  private:
    std::vector<boost::shared_ptr<ICIMQualifier>> fOwn;
    const TInMemQualifierSet* fParent = nullptr;
};

}  // namespace NORVZEL20
