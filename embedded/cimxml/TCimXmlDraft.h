#pragma once

#include <string>
#include <vector>

#include "embedded/cimxml/TCimXmlContext.h"
#include "embedded/value/TEmbeddedObject.h"

namespace NORVZEL20 {

/// A class or an instance as a document tells it, with where it stands there, until it can be made part of a namespace.
struct TCimXmlDraft {
    TEmbeddedObject object;
    TCimXmlContext::TPlace place;
    std::vector<TCimXmlContext::TPlace> propertyPlaces;      ///< in the order of the object's properties
    std::vector<std::pair<std::string, TCIMValue>> ownKeys;  ///< of an instance: the keys of the name in front of it
};

/// A qualifier's declaration as a document tells it.
struct TCimXmlQualifierDraft {
    std::string name;
    TCIMValue value;  ///< gives the type; a typed null where there is no default
    ICIMQualifierDecl::EScope scope = ICIMQualifierDecl::kScopeNone;
    ICIMQualifierDecl::EFlavor flavor = ICIMQualifierDecl::kFlavorDefault;
};

}  // namespace NORVZEL20
