#pragma once

#include "host/ICIMQualifierDecl.h"

namespace NORVZEL20 {

/// One bit of a scope or a flavor, as an attribute that is "true" or "false".
struct TCimXmlFlag {
    const char* attribute;
    unsigned int bit;
};

/// The attributes of SCOPE, in the order in which they are written. ANY stands for all of them.
inline constexpr TCimXmlFlag kCimXmlScopes[] = {
    {"CLASS", ICIMQualifierDecl::kScopeClass},           {"ASSOCIATION", ICIMQualifierDecl::kScopeAssociation},
    {"REFERENCE", ICIMQualifierDecl::kScopeReference},   {"PROPERTY", ICIMQualifierDecl::kScopeProperty},
    {"METHOD", ICIMQualifierDecl::kScopeMethod},         {"PARAMETER", ICIMQualifierDecl::kScopeParameter},
    {"INDICATION", ICIMQualifierDecl::kScopeIndication},
};

/// The attributes of a flavor, in the order in which they are written. One that is absent is as in kFlavorDefault.
inline constexpr TCimXmlFlag kCimXmlFlavors[] = {
    {"OVERRIDABLE", ICIMQualifierDecl::kFlavorOverridable},
    {"TOSUBCLASS", ICIMQualifierDecl::kFlavorToSubclass},
    {"TOINSTANCE", ICIMQualifierDecl::kFlavorToInstance},
    {"TRANSLATABLE", ICIMQualifierDecl::kFlavorTranslatable},
};

}  // namespace NORVZEL20
