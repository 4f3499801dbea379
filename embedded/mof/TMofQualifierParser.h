#pragma once

#include <vector>

#include "embedded/load/TQualifierDraft.h"
#include "embedded/mof/IMofSink.h"
#include "embedded/mof/TMofTokens.h"
#include "embedded/mof/TMofValue.h"
#include "embedded/value/TEmbeddedObject.h"

namespace NORVZEL20 {

/// Reads qualifiers and their declarations.
///
/// Errors: kParseError (9) for what the grammar does not have and for more qualifiers than TSchemaLimits allows, kTypeMismatch (13)
/// for a value of another type than the declared one.
class TMofQualifierParser {
  public:
    using TQualifiers = std::vector<TEmbeddedObject::TQualifier>;

    /// Both must outlive the parser.
    TMofQualifierParser(TMofTokens& tokens, IMofSink& sink) noexcept : fTokens(tokens), fSink(sink) {}

    /// A list in square brackets; empty if the present token does not begin one. A qualifier without a value is true if it is
    /// boolean, otherwise it has the value of its declaration. Flavors that are not written are those of the declaration.
    TQualifiers ReadList();
    /// A declaration, from the word behind "qualifier" to the semicolon.
    TQualifierDraft ReadDecl();

    /// Whether ReadList has met a qualifier that is not declared. Such a one has the type that its value suggests.
    bool HasMetUndeclared() const noexcept { return fHasMetUndeclared; }

    /// Reads a list, if there is one, and drops it.
    static void Skip(TMofTokens& tokens);

  private:
    /// What flavors change.
    struct TFlavor {
        unsigned int set = 0;
        unsigned int cleared = 0;

        ICIMQualifierDecl::EFlavor ChangeFrom(unsigned int flavor) const noexcept
        {
            return static_cast<ICIMQualifierDecl::EFlavor>((flavor & ~cleared) | set);
        }
    };

    /// A qualifier as it is written.
    struct TWritten {
        std::string name;
        bool hasValue = false;
        TMofValue value;
        TFlavor flavor;
    };

    static TWritten ReadWritten(TMofTokens& tokens);
    static void AddFlavor(TMofTokens& tokens, TFlavor& flavor);
    TEmbeddedObject::TQualifier Complete(const TWritten& written);
    TEmbeddedObject::TQualifier Guess(const TWritten& written);
    unsigned int ReadScope();

    TMofTokens& fTokens;
    IMofSink& fSink;
    bool fHasMetUndeclared = false;
};

}  // namespace NORVZEL20
