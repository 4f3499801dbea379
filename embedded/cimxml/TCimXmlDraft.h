#pragma once

#include <string>
#include <vector>

#include "embedded/cimxml/TXmlPlace.h"
#include "embedded/value/TEmbeddedObject.h"

namespace NORVZEL20 {

/// A class or an instance as a document describes it, with its place there, until it can be added to a namespace.
struct TCimXmlDraft {
    TEmbeddedObject object;
    TXmlPlace place;
    std::vector<TXmlPlace> propertyPlaces;                   ///< in the order of the object's properties
    std::vector<std::pair<std::string, TCIMValue>> ownKeys;  ///< for an instance: the keys of the name in front of it
};

/// A qualifier's declaration as a document describes it.
struct TCimXmlQualifierDraft {
    std::string name;
    TCIMValue value;  ///< has the type; a typed null if there is no default
    ICIMQualifierDecl::EScope scope = ICIMQualifierDecl::kScopeNone;
    ICIMQualifierDecl::EFlavor flavor = ICIMQualifierDecl::kFlavorDefault;
};

}  // namespace NORVZEL20
