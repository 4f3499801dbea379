#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "embedded/store/TInMemMethodDecl.h"
#include "embedded/store/TInMemPropertyDecl.h"
#include "embedded/store/TInMemQualifier.h"

namespace NORVZEL20 {

class TInMemClass;

/// Makes in-memory copies of declarations of any host.
///
/// A copy has all qualifiers that the original shows, inherited ones included. The class of a reference, the size of an array and
/// the parameters of a method are not part of the host's interfaces; they are copied from in-memory originals only.
class TDeclCopy {
  public:
    TDeclCopy() = delete;

    static boost::shared_ptr<TInMemPropertyDecl> CopyProperty(const ICIMPropertyDecl& source);
    static boost::shared_ptr<TInMemMethodDecl> CopyMethod(const ICIMMethodDecl& source);
    static boost::shared_ptr<TInMemQualifier> CopyQualifier(const ICIMQualifier& source);
    /// The element's own qualifiers, onto `copy`.
    static void CopyOwnQualifiers(const TInMemQualifierSet& source, ICIMNamedElement& copy);
};

}  // namespace NORVZEL20
