#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <string_view>
#include <vector>

#include "embedded/TInMemNamespace.h"

namespace NORVZEL20 {

/// Declares in one namespace what another one declares. What is copied is independent of where it came from.
///
/// Qualifier declarations that the copies need and the target lacks are copied too. Instances are not.
class TSchemaCopier {
  public:
    explicit TSchemaCopier(boost::shared_ptr<TInMemNamespace> target) : fTarget(std::move(target)) {}

    /// Declares `source` with all that it declares itself, after those of its superclasses that the target lacks. Returns the
    /// classes declared, superclasses first; none where the target has the class (in whatever spelling).
    /// Errors: status 13 where an inherited property has another type in the target; nothing is declared then.
    std::vector<boost::shared_ptr<TInMemClass>> CopyClass(const TInMemClass& source);

    /// Declares a property of another namespace's class in `cls`, a class of the target, with its qualifiers. Returns null where
    /// it has the property (own or inherited). Instances that are there get a null.
    boost::shared_ptr<TInMemPropertyDecl> CopyPropertyDecl(const TInMemPropertyDecl& source, TInMemClass& cls);

    /// Gives the target's class, where it has one, the spelling `name`; false where it is spelled so, or there is none.
    bool RespellClass(const std::string& name);
    /// The same for a property that `cls` itself declares or overrides.
    bool RespellProperty(TInMemClass& cls, const std::string& name);

  private:
    boost::shared_ptr<TInMemClass> MakeClass(const TInMemClass& source, boost::shared_ptr<TInMemClass> superClass);
    void CopyMethods(const TInMemClass& source, TInMemClass& copy);
    void CopyQualifiers(const TInMemQualifierSet& source, const TInMemNamespace* from, ICIMNamedElement& copy);

    boost::shared_ptr<TInMemNamespace> fTarget;
};

}  // namespace NORVZEL20
