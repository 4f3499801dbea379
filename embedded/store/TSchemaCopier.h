#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "embedded/store/TInMemNamespace.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// Declares in one namespace, the target, what another one declares. A later change of the original does not change the copy.
///
/// Qualifier declarations that the copies need and the target lacks are copied too. Instances are not.
/// Threads: as both namespaces.
class CIMDELTA_INTERNAL_EXPORT TSchemaCopier {
  public:
    explicit TSchemaCopier(boost::shared_ptr<TInMemNamespace> target) : fTarget(std::move(target)) {}

    /// Declares `source` with all that it declares itself, after those of its superclasses that the target lacks. Returns the
    /// classes declared, superclasses first; none if the target has the class, in any spelling. A class that a reference names need
    /// not be there.
    /// Errors: kTypeMismatch (13) if an inherited property has another type in the target, TSchemaLimitError if a class would go
    /// beyond TSchemaLimits; no class is declared then.
    std::vector<boost::shared_ptr<TInMemClass>> CopyClass(const TInMemClass& source);

    /// Declares a property of another namespace's class in `cls`, a class of the target, with its qualifiers. Returns null if
    /// it has the property, own or inherited. Its instances get a null, of a static property too.
    /// Errors: kTypeMismatch (13) if a class below has the property with another type, TSchemaLimitError if the class, or one
    /// below, would have too many.
    boost::shared_ptr<TInMemPropertyDecl> CopyPropertyDecl(const TInMemPropertyDecl& source, TInMemClass& cls);

    /// Gives the target's class of that name the spelling `name`. Returns false if there is none, or if it is spelled so already.
    bool RespellClass(const std::string& name);
    /// The same for a property of `cls`. An inherited one keeps its spelling in the superclass: `cls` overrides it with a copy that
    /// differs in nothing else. References to instances keep the old spelling of keys; TReferenceAdapter changes that.
    bool RespellProperty(TInMemClass& cls, const std::string& name);

  private:
    boost::shared_ptr<TInMemClass> MakeClass(const TInMemClass& source);
    /// Declares the qualifiers of `element` that `from` declares and the target does not.
    void CopyQualifierDecls(const TInMemQualifierSet& element, const TInMemNamespace* from);

    boost::shared_ptr<TInMemNamespace> fTarget;
};

}  // namespace NORVZEL20
