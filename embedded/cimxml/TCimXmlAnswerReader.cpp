#include "embedded/cimxml/TCimXmlAnswerReader.h"

#include <map>
#include <string>

#include "embedded/cimxml/DescribeCimStatus.h"
#include "embedded/load/MessageText.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

using EStatus = TZELStatusCode::EStatusCode;
using TElement = TCimXmlElement;

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
    fContext.Fail(EStatus::kParseError, "found an error as the answer" + to + ": " + DescribeCimStatus(attributes.Get("CODE")) +
                                            ", " + Quote(attributes.Get("DESCRIPTION")) + "; expected an answer with objects; " +
                                            AdviseOnStatus(attributes.Get("CODE")));
}

void TCimXmlAnswerReader::RefuseRequest(const TCimXmlAttributes& attributes) const
{
    fContext.Fail(EStatus::kParseError, "found a request to a server (" + Quote(attributes.Get("NAME")) +
                                            "), which is no inventory; load the server's answer instead");
}

}  // namespace NORVZEL20
