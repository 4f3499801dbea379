#pragma once

#include <string>

#include "embedded/cimxml/TCimXmlAttributes.h"
#include "embedded/cimxml/TCimXmlItem.h"
#include "embedded/load/TQualifierDraft.h"
#include "embedded/value/TEmbeddedObject.h"

namespace NORVZEL20 {

/// Reads a QUALIFIER or a QUALIFIER.DECLARATION; its value goes into GetItem. One at a time: qualifiers do not nest.
///
/// Errors: fails through the context with kParseError (9) if the name or the type is missing or unknown.
class TCimXmlQualifierReader {
  public:
    /// Both arguments must outlive the reader.
    TCimXmlQualifierReader(TLoadContext& context, TCimXmlObjectReader& objects) noexcept : fItem(context, objects) {}

    void Begin(const TCimXmlAttributes& attributes);
    /// The qualifier that has ended.
    TEmbeddedObject::TQualifier Take();

    void BeginDecl(const TCimXmlAttributes& attributes);
    /// Reads SCOPE; a second one adds to the first.
    void ReadScope(const TCimXmlAttributes& attributes);
    /// The declaration that has ended.
    TQualifierDraft TakeDecl();

    TCimXmlItem& GetItem() noexcept { return fItem; }

  private:
    std::string fName;
    TCimXmlItem fItem;
    ICIMQualifierDecl::EFlavor fFlavor = ICIMQualifierDecl::kFlavorDefault;
    bool fIsPropagated = false;  // of a qualifier
    unsigned int fScope = 0;     // of a declaration
};

}  // namespace NORVZEL20
