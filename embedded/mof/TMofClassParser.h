#pragma once

#include "embedded/load/TDraft.h"
#include "embedded/mof/IMofSink.h"
#include "embedded/mof/TMofQualifierParser.h"
#include "embedded/mof/TMofTokens.h"

namespace NORVZEL20 {

/// Reads one class. Errors: kParseError (9) for what the grammar does not have, for a property that comes twice, and for more parts
/// than TSchemaLimits allows; kTypeMismatch (13) for a default or a qualifier that does not fit its type.
class TMofClassParser {
  public:
    /// Both must outlive the parser.
    TMofClassParser(TMofTokens& tokens, IMofSink& sink) noexcept : fTokens(tokens), fQualifiers(tokens, sink) {}

    /// The list of qualifiers in front of a class or an instance; the next call of Read adds it to the class.
    void ReadQualifiers() { fOfClass = fQualifiers.ReadList(); }
    /// The class, from the word behind "class" to the semicolon. `place` is where it begins.
    TDraft Read(const TLoadPlace& place);

    /// See TMofQualifierParser.
    bool HasMetUndeclared() const noexcept { return fQualifiers.HasMetUndeclared(); }

  private:
    using TQualifiers = TMofQualifierParser::TQualifiers;

    void ReadFeature(TDraft& draft);
    void ReadMethod(TDraft& draft, TEmbeddedObject::TMethod method);
    void ReadProperty(TDraft& draft, TEmbeddedObject::TProperty property, TCIMValue::TCIMType type, const TLoadPlace& place);
    TEmbeddedObject::TParameter ReadParameter();
    void CheckRoom(std::size_t count, std::size_t most, const char* what, const TDraft& draft) const;

    TMofTokens& fTokens;
    TMofQualifierParser fQualifiers;
    TQualifiers fOfClass;
};

}  // namespace NORVZEL20
