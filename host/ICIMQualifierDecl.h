#pragma once

#include <string>

#include "host/Export.h"
#include "host/TCIMValue.h"
#include "host/TCallContext.h"

namespace NORVZEL20 {

/// The declaration of a qualifier: its type and default, which elements may have it, and how it is inherited.
class CIMDELTA_EXPORT ICIMQualifierDecl {
  public:
    /// The elements that may have the qualifier; a set of bits (DSP0004, 5.6.2).
    enum EScope : unsigned int {
        kScopeNone = 0,
        kScopeClass = 1,
        kScopeAssociation = 2,
        kScopeIndication = 4,
        kScopeProperty = 8,
        kScopeReference = 16,
        kScopeMethod = 32,
        kScopeParameter = 64,
        kScopeAny = 127
    };

    /// How the qualifier is inherited; a set of bits (DSP0004, 5.6.2, and the defaults of DSP0201).
    enum EFlavor : unsigned int {
        kFlavorNone = 0,
        kFlavorOverridable = 1,  ///< a subclass may give another value
        kFlavorToSubclass = 2,   ///< subclasses have it too
        kFlavorToInstance = 4,   ///< obsolete; kept and written back
        kFlavorTranslatable = 8,
        kFlavorDefault = 3  ///< overridable and inherited
    };

    virtual ~ICIMQualifierDecl() = default;

    /// The name as declared. Valid while the declaration lives.
    virtual const std::string& GetName(TCallContext context) const = 0;
    /// The default value, or a typed null. Valid while the declaration lives.
    virtual const TCIMValue& GetValue(TCallContext context) const = 0;
    virtual EScope GetScope(TCallContext context) const = 0;
    virtual EFlavor GetFlavor(TCallContext context) const = 0;
};

}  // namespace NORVZEL20
