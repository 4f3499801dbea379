// A recursive-descent parser for MOF, the Managed Object Format (DSP0004 2.x, annex A): an operation for each rule.
//
//     document    {production}
//     production  # pragma NAME ( TEXT ) | class | instance ; | qualifier declaration
//
// Keywords may be in any letter case and are names elsewhere. The rules for the parts are in the parsers of the parts. Each reads
// what its rule describes and leaves the next token as the present one.
//
// A use of a qualifier takes type and flavor from the qualifier's declaration. If that has not come yet, the class is read in order
// to find its end, and kept as text until more is declared.
#include "embedded/mof/TMofParser.h"

#include <utility>

#include "embedded/mof/TMofQualifierParser.h"
#include "embedded/mof/TMofValueParser.h"

namespace NORVZEL20 {

void TMofParser::Parse()
{
    fTokens.Advance();
    while (!fTokens.Is(TMofToken::kEnd)) {
        ReadProduction();
    }
}

void TMofParser::ReadProduction()
{
    const TMofToken first = fTokens.Get();
    const TLoadPlace place = fTokens.GetPlace();
    if (fTokens.IsSymbol('#')) {
        return ReadPragma();
    }
    if (fTokens.TakeKeyword("qualifier")) {
        return fSink.OnQualifierDecl(TMofQualifierParser(fTokens, fSink).ReadDecl());
    }
    TMofClassParser parser(fTokens, fSink);
    parser.ReadQualifiers();
    const TLoadPlace begin = fTokens.GetPlace();
    if (fTokens.TakeKeyword("class")) {
        return ReadClass(parser, begin, first, place);
    }
    if (!fTokens.TakeKeyword("instance")) {
        fTokens.FailExpected("a class, an instance, a qualifier or #pragma");
    }
    ReadInstance(begin);
}

void TMofParser::ReadPragma()
{
    fTokens.Advance();
    fTokens.ExpectKeyword("pragma");
    const std::string name = fTokens.ExpectName("the name of a pragma");
    fTokens.ExpectSymbol('(', "behind the name of the pragma");
    const TMofValue value = TMofValueParser(fTokens).ReadElement();
    if (!fTokens.IsSymbol(')')) {
        fTokens.FailExpected(") behind the text of the pragma");
    }
    // An included document is read with the parenthesis still to be taken, so that the present place is here.
    fSink.OnPragma(name, value.text);
    fTokens.Advance();
}

void TMofParser::ReadClass(TMofClassParser& parser, const TLoadPlace& begin, const TMofToken& first, const TLoadPlace& place)
{
    TDraft draft = parser.Read(begin);
    if (parser.HasMetUndeclared()) {
        // What follows the class is the present token, or the end.
        const std::size_t end = fTokens.Get().offset;
        if (!fSink.OnUndeclared({std::string(fText.substr(first.offset, end - first.offset)), place})) {
            return;
        }
    }
    fSink.OnClass(std::move(draft));
}

void TMofParser::ReadInstance(const TLoadPlace& place)
{
    TMofInstance instance = TMofValueParser(fTokens).ReadInstance(place);
    fTokens.ExpectSymbol(';', "behind the instance");
    fSink.OnInstance(std::move(instance));
}

}  // namespace NORVZEL20
