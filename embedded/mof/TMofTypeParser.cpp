#include "embedded/mof/TMofTypeParser.h"

#include "embedded/value/TNameText.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

using TType = TCIMValue::TCIMType;

/// "reference" is a type in CIM-XML only.
TType FindMofType(const std::string& name)
{
    const TType type = TValueText::FindType(TNameText::ToLower(name));
    return type == TType::kReference ? TType(TType::kNone) : type;
}

}  // namespace

TCIMValue::TCIMType TMofTypeParser::ReadType(TMofTokens& tokens)
{
    const TType type = tokens.Is(TMofToken::kName) ? FindMofType(tokens.Get().text) : TType(TType::kNone);
    if (type == TType::kNone) {
        tokens.FailExpected("a type, such as string or uint32");
    }
    tokens.Advance();
    return type;
}

TCIMValue::TCIMType TMofTypeParser::ReadTypeOrReference(TMofTokens& tokens, std::string& referenceClass)
{
    const std::string name = tokens.ExpectName("a type, the name of a class or }");
    const TType type = FindMofType(name);
    if (type != TType::kNone) {
        return type;
    }
    if (tokens.TakeKeyword("ref")) {
        referenceClass = name;
        return TType::kReference;
    }
    if (!TNameText::Equal(name, "void")) {
        tokens.FailExpected("\"ref\" behind " + name + ", which is no type");
    }
    return TType::kNone;
}

TCIMValue::TCIMType TMofTypeParser::ReadArraySize(TMofTokens& tokens, TCIMValue::TCIMType type, unsigned int& size)
{
    size = 0;
    if (!tokens.TakeSymbol('[')) {
        return type;
    }
    if (!tokens.IsSymbol(']')) {
        TCIMValue number;
        if (!tokens.Is(TMofToken::kInteger) || !TValueText::Parse(TType::kUint32, tokens.Get().text, number) ||
            number.GetUnsigned() == 0) {
            tokens.FailExpected("] or the number of elements");
        }
        size = static_cast<unsigned int>(number.GetUnsigned());
        tokens.Advance();
    }
    tokens.ExpectSymbol(']', "behind the number of elements");
    return type.GetArrayType();
}

}  // namespace NORVZEL20
