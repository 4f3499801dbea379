#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "embedded/store/TInMemMethodDecl.h"
#include "embedded/store/TInMemPropertyDecl.h"
#include "embedded/store/TInMemQualifier.h"

namespace NORVZEL20 {

class TInMemClass;

/// Makes in-memory copies of declarations, whatever made the originals; each with all qualifiers that the original shows, inherited
/// ones included. Beyond what the interfaces tell (class of a reference, sizes, parameters), only in-memory originals have more to
/// give.
class TDeclCopy {
  public:
    TDeclCopy() = delete;

    static boost::shared_ptr<TInMemPropertyDecl> CopyProperty(const ICIMPropertyDecl& source);
    static boost::shared_ptr<TInMemMethodDecl> CopyMethod(const ICIMMethodDecl& source);
    static boost::shared_ptr<TInMemQualifier> CopyQualifier(const ICIMQualifier& source);
    /// The element's own qualifiers, onto `copy`.
    static void CopyOwnQualifiers(const TInMemQualifierSet& source, ICIMNamedElement& copy);

    /// Errors: status 13 where a property or method that both classes have differs in type.
    static void CheckTypes(const ICIMClass& source, const TInMemClass& target);
};

}  // namespace NORVZEL20
