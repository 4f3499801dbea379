#pragma once

#include <string>

#include "host/ICIMQualifierDecl.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// A qualifier's declaration as a document describes it.
struct TQualifierDraft {
    std::string name;
    TCIMValue value;  ///< has the type; a typed null if there is no default
    ICIMQualifierDecl::EScope scope = ICIMQualifierDecl::kScopeNone;
    ICIMQualifierDecl::EFlavor flavor = ICIMQualifierDecl::kFlavorDefault;
};

}  // namespace NORVZEL20
