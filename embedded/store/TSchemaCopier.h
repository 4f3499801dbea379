#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <string_view>
#include <vector>

#include "embedded/store/TInMemNamespace.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// Declares in one namespace what another one declares. What is copied does not change with where it came from.
///
/// Qualifier declarations that the copies need and the target lacks are copied too. Instances are not.
class CIMDELTA_INTERNAL_EXPORT TSchemaCopier {
  public:
    explicit TSchemaCopier(boost::shared_ptr<TInMemNamespace> target) : fTarget(std::move(target)) {}

    /// Declares `source` with all that it declares itself, after those of its superclasses that the target lacks. Returns the
    /// classes declared, superclasses first; none where the target has the class (in whatever spelling).
    /// A class named by a reference need not be there. Errors: status 13 where an inherited property has another type in the
    /// target, TSchemaLimitError where a class would go beyond TSchemaLimits; no class is declared then.
    std::vector<boost::shared_ptr<TInMemClass>> CopyClass(const TInMemClass& source);

    /// Declares a property of another namespace's class in `cls`, a class of the target, with its qualifiers. Returns null where
    /// it has the property (own or inherited). Instances that are there get a null. Errors: status 13 where a subclass has the
    /// property with another type, TSchemaLimitError where the class, or one below, would have too many.
    boost::shared_ptr<TInMemPropertyDecl> CopyPropertyDecl(const TInMemPropertyDecl& source, TInMemClass& cls);

    /// Gives the target's class, where it has one, the spelling `name`; false where it is spelled so, or there is none.
    bool RespellClass(const std::string& name);
    /// The same for a property of `cls`. One that it inherits keeps its spelling above: `cls` overrides it, all else the same.
    /// References keep their texts; see TReferenceAdapter.
    bool RespellProperty(TInMemClass& cls, const std::string& name);

  private:
    boost::shared_ptr<TInMemClass> MakeClass(const TInMemClass& source);
    /// Declares the qualifiers of `element` that the target lacks, where they are declared in `from`.
    void CopyQualifierDecls(const TInMemQualifierSet& element, const TInMemNamespace* from);

    boost::shared_ptr<TInMemNamespace> fTarget;
};

}  // namespace NORVZEL20
