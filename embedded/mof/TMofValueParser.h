#pragma once

#include "embedded/mof/TMofInstance.h"
#include "embedded/mof/TMofTokens.h"
#include "embedded/mof/TMofValue.h"

namespace NORVZEL20 {

/// Reads values and instances, which may contain each other.
///
/// Errors: kParseError (9) for what the grammar does not have, for instances nested too deeply, for a property that an instance has
/// twice, and for more properties than TSchemaLimits allows.
class TMofValueParser {
  public:
    /// `tokens` must outlive the parser.
    explicit TMofValueParser(TMofTokens& tokens) noexcept : fTokens(tokens) {}

    /// What stands behind "=".
    TMofValue ReadInitializer();
    /// What stands between parentheses, such as the value of a qualifier: no array.
    TMofValue ReadElement();
    /// What stands between braces. The present token is the opening brace.
    TMofValue ReadArray();
    /// An instance, from the word behind "instance" to its closing brace. `place` is that of "instance".
    TMofInstance ReadInstance(const TLoadPlace& place);

  private:
    TMofValue ReadText();
    TMofValue ReadWord();
    TMofValue ReadObject();
    TMofInstance::TProperty ReadProperty();
    void AddProperty(TMofInstance& instance, TMofInstance::TProperty property) const;

    TMofTokens& fTokens;
};

}  // namespace NORVZEL20
