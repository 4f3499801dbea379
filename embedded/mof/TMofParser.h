#pragma once

#include <string_view>

#include "embedded/mof/IMofSink.h"
#include "embedded/mof/TMofClassParser.h"
#include "embedded/mof/TMofTokens.h"

namespace NORVZEL20 {

/// Reads a document, one production after the other, and gives each to a sink.
///
/// Errors: fails through the context, with kParseError (9) for what the grammar does not have, and as the other parsers; what the
/// sink throws passes. Cost: one pass.
class TMofParser {
  public:
    /// `text` is what `tokens` reads. All arguments must outlive the parser.
    TMofParser(TMofTokens& tokens, std::string_view text, IMofSink& sink) noexcept : fTokens(tokens), fText(text), fSink(sink) {}

    /// Reads to the end. The context must know the tokens' reader.
    void Parse();

  private:
    void ReadProduction();
    void ReadPragma();
    void ReadClass(TMofClassParser& parser, const TLoadPlace& begin, const TMofToken& first, const TLoadPlace& place);
    void ReadInstance(const TLoadPlace& place);

    TMofTokens& fTokens;
    std::string_view fText;
    IMofSink& fSink;
};

}  // namespace NORVZEL20
