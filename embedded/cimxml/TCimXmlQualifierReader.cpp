#include "embedded/cimxml/TCimXmlQualifierReader.h"

#include "embedded/cimxml/CimXmlFlags.h"

namespace NORVZEL20 {

namespace {

using TDecl = ICIMQualifierDecl;

TDecl::EFlavor ReadFlavor(const TCimXmlAttributes& attributes)
{
    unsigned int flavor = TDecl::kFlavorNone;
    for (const TCimXmlFlag& flag : kCimXmlFlavors) {
        if (attributes.IsTrue(flag.attribute, (TDecl::kFlavorDefault & flag.bit) != 0)) {
            flavor |= flag.bit;
        }
    }
    return static_cast<TDecl::EFlavor>(flavor);
}

}  // namespace

void TCimXmlQualifierReader::Begin(const TCimXmlAttributes& attributes)
{
    fName = attributes.Require("NAME");
    fItem.Begin(fName, attributes.RequireType(), EValueText::kPlain);
    fFlavor = ReadFlavor(attributes);
    fIsPropagated = attributes.IsTrue("PROPAGATED", false);
}

TEmbeddedObject::TQualifier TCimXmlQualifierReader::Take()
{
    return {fName, fItem.Take(), fFlavor, fIsPropagated};
}

void TCimXmlQualifierReader::BeginDecl(const TCimXmlAttributes& attributes)
{
    const TCIMValue::TCIMType type = attributes.RequireType();
    fName = attributes.Require("NAME");
    fItem.Begin(fName, attributes.IsTrue("ISARRAY", false) ? type.GetArrayType() : type, EValueText::kPlain);
    fFlavor = ReadFlavor(attributes);
    fScope = 0;
}

/// No DTD has ANY, but some writers use it.
void TCimXmlQualifierReader::ReadScope(const TCimXmlAttributes& attributes)
{
    for (const TCimXmlFlag& flag : kCimXmlScopes) {
        if (attributes.IsTrue(flag.attribute, false)) {
            fScope |= flag.bit;
        }
    }
    if (attributes.IsTrue("ANY", false)) {
        fScope |= TDecl::kScopeAny;
    }
}

TQualifierDraft TCimXmlQualifierReader::TakeDecl()
{
    return {fName, fItem.Take(), static_cast<TDecl::EScope>(fScope), fFlavor};
}

}  // namespace NORVZEL20
