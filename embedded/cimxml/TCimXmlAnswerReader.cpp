#include "embedded/cimxml/TCimXmlAnswerReader.h"

#include <array>
#include <map>
#include <string>

#include "embedded/load/MessageText.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

using EStatus = TZELStatusCode::EStatusCode;
using TElement = TCimXmlElement;

/// What a status that a server answers with is called (DSP0200). Numbers without a name were never assigned.
constexpr std::array<const char*, 29> kStatusNames = {"",
                                                      "CIM_ERR_FAILED",
                                                      "CIM_ERR_ACCESS_DENIED",
                                                      "CIM_ERR_INVALID_NAMESPACE",
                                                      "CIM_ERR_INVALID_PARAMETER",
                                                      "CIM_ERR_INVALID_CLASS",
                                                      "CIM_ERR_NOT_FOUND",
                                                      "CIM_ERR_NOT_SUPPORTED",
                                                      "CIM_ERR_CLASS_HAS_CHILDREN",
                                                      "CIM_ERR_CLASS_HAS_INSTANCES",
                                                      "CIM_ERR_INVALID_SUPERCLASS",
                                                      "CIM_ERR_ALREADY_EXISTS",
                                                      "CIM_ERR_NO_SUCH_PROPERTY",
                                                      "CIM_ERR_TYPE_MISMATCH",
                                                      "CIM_ERR_QUERY_LANGUAGE_NOT_SUPPORTED",
                                                      "CIM_ERR_INVALID_QUERY",
                                                      "CIM_ERR_METHOD_NOT_AVAILABLE",
                                                      "CIM_ERR_METHOD_NOT_FOUND",
                                                      "",
                                                      "",
                                                      "CIM_ERR_NAMESPACE_NOT_EMPTY",
                                                      "CIM_ERR_INVALID_ENUMERATION_CONTEXT",
                                                      "CIM_ERR_INVALID_OPERATION_TIMEOUT",
                                                      "CIM_ERR_PULL_HAS_BEEN_ABANDONED",
                                                      "CIM_ERR_PULL_CANNOT_BE_ABANDONED",
                                                      "CIM_ERR_FILTERED_ENUMERATION_NOT_SUPPORTED",
                                                      "CIM_ERR_CONTINUATION_ON_ERROR_NOT_SUPPORTED",
                                                      "CIM_ERR_SERVER_LIMITS_EXCEEDED",
                                                      "CIM_ERR_SERVER_IS_SHUTTING_DOWN"};

/// "CIM_ERR_NOT_FOUND (6)"; for an unknown number, or something else than a number, that alone.
std::string DescribeStatus(const char* code)
{
    TCIMValue number;
    const bool isNumber = TValueText::Parse(TCIMValue::TCIMType::kUint32, code, number);
    if (!isNumber || number.GetUnsigned() >= kStatusNames.size() || *kStatusNames[number.GetUnsigned()] == '\0') {
        return "status " + Quote(code);
    }
    return std::string(kStatusNames[number.GetUnsigned()]) + " (" + code + ")";
}

/// What can be done about a status that a server answers with, by its number.
const char* AdviseOnStatus(const std::string& code)
{
    static const std::map<std::string, const char*> kAdvice = {
        {"2", "ask as a user who may read this"},
        {"3", "correct the namespace that the request names"},
        {"4", "correct the parameters of the request"},
        {"5", "correct the class that the request names"},
        {"6", "correct the name in the request"},
        {"7", "ask for the objects with another operation"},
        {"14", "correct the language of the query"},
        {"15", "correct the query"},
        {"21", "begin again with the operation that opens the enumeration"},
        {"25", "ask without a filter"},
        {"26", "ask without continuation on error"},
    };
    const auto known = kAdvice.find(code);
    return known != kAdvice.end() ? known->second : "ask the server again";
}

/// What to say if a load holds nothing but that element.
const char* DescribeSkipped(TElement::EElement element)
{
    switch (element) {
    case TElement::kMethodResponse:
        return "the answer to the call of a method, which holds no inventory; load answers with instances";
    case TElement::kValue:
    case TElement::kValueArray:
    case TElement::kValueReference:
        return "a value without its class and key; load the instance that it belongs to, as GetInstance returns it";
    default:
        return "a list of names; names have no values, so load the objects instead, for instance the answer to EnumerateInstances"
               " instead of the one to EnumerateInstanceNames";
    }
}

}  // namespace

void TCimXmlAnswerReader::Begin(const TCimXmlAttributes& attributes)
{
    fOperation = attributes.Get("NAME");
    fContext.GetContents().BeginAnswer(fOperation, fContext.GetPlace());
}

void TCimXmlAnswerReader::EndOutput(std::string_view text)
{
    if (TNameText::Equal(fOutput, "EndOfSequence") && TNameText::Equal(text, "TRUE")) {
        fContext.GetContents().NoteEndOfSequence();
    }
}

void TCimXmlAnswerReader::Skip(const TCimXmlAttributes& attributes)
{
    const char* name = TElement::GetName(attributes.GetElement());
    if (attributes.GetElement() == TElement::kMethodResponse) {
        fOperation = attributes.Get("NAME");
    }
    fContext.Tolerate(name, std::string("<") + name + "> holds no class or instance; left out");
    fContext.GetContents().NoteOther(DescribeSkipped(attributes.GetElement()), fContext.GetPlace());
}

void TCimXmlAnswerReader::RefuseError(const TCimXmlAttributes& attributes) const
{
    const std::string to = fOperation.empty() ? "" : " to " + Quote(fOperation);
    fContext.Fail(EStatus::kParseError, "found an error as the answer" + to + ": " + DescribeStatus(attributes.Get("CODE")) + ", " +
                                            Quote(attributes.Get("DESCRIPTION")) + "; expected an answer with objects; " +
                                            AdviseOnStatus(attributes.Get("CODE")));
}

void TCimXmlAnswerReader::RefuseRequest(const TCimXmlAttributes& attributes) const
{
    fContext.Fail(EStatus::kParseError, "found a request to a server (" + Quote(attributes.Get("NAME")) +
                                            "), which is no inventory; load the server's answer instead");
}

}  // namespace NORVZEL20
