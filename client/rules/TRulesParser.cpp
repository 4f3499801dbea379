// The plug-in's parser keeps a stack of states, one for each open element that it has accepted. Each tag first goes to the plug-in;
// what the stack looks like afterwards says what the plug-in made of it:
//
//     start tag    a new state                 accepted
//                  no new state                ignored, because it is inside "value"
//                  exception, a new state      its attributes are refused
//                  exception, no new state     the element is refused
//     end tag      "value" was on top          the text is a property's name, accepted unless there is an exception
//                  anything else               nothing to note
//
// A tag's name alone says little: inside "value" any start tag is ignored, and any end tag ends the value.
#include "client/rules/TRulesParser.h"

#include <boost/algorithm/string/predicate.hpp>
#include <utility>

#include "client/process/LackOfMemory.h"
#include "client/process/TClientError.h"
#include "client/rules/TLogCapture.h"
#include "embedded/value/TUtf8.h"
#include "host/TXmlParser.h"
#include "host/TZELException.h"
#include "spec/TDiffClassRules.h"

namespace NORVZEL20 {

namespace {

using TAttributes = std::map<std::string, std::string>;

// How many states the stack has inside an element; the first one stands for the document.
const std::size_t kInRoot = 2;
const std::size_t kInClass = 3;
const std::size_t kInList = 4;
const std::size_t kInValue = 5;

const char kInvalidToken[] = "not well-formed (invalid token)";

TRulesFault MakeFault(TRulesFault::EKind kind, const std::string& text = std::string())
{
    TRulesFault fault;
    fault.kind = kind;
    fault.text = text;
    return fault;
}

TRulesFault FindRootFault(const TAttributes& attrs)
{
    for (const auto& [name, value] : attrs) {
        if (name != "version") {
            return MakeFault(TRulesFault::kUnknownRootAttribute, name);
        }
    }
    return MakeFault(TRulesFault::kUnknownVersion, attrs.at("version"));
}

// Finds the first fault in the plug-in's order: the attributes by name, then what is missing.
TRulesFault FindClassFault(const TAttributes& attrs)
{
    for (const auto& [name, value] : attrs) {
        if (name == "default" && value != "include" && value != "exclude") {
            return MakeFault(TRulesFault::kInvalidDefault, value);
        }
        if (name != "default" && name != "excludekeys" && name != "name") {
            return MakeFault(TRulesFault::kUnknownClassAttribute, name);
        }
    }
    const auto name = attrs.find("name");
    return MakeFault(name == attrs.end() || name->second.empty() ? TRulesFault::kNoClassName : TRulesFault::kUnknownClass);
}

// Reads XML and keeps the reason if it is not well-formed.
class TXmlReason : public TXmlParser {
  public:
    void FatalError(const char* message) override { fReason = message; }
    const std::string& Find(std::string text)
    {
        Parse(text.data(), text.size());
        return fReason;
    }

  private:
    std::string fReason;
};

// Whether the text, which the XML parser could begin to read, is meant to be UTF-8. Of the encodings that are read, the one of 16
// bits begins with its mark or with an ASCII character, which has a zero byte; the others stand in the XML declaration.
bool IsMeantAsUtf8(const std::string& text)
{
    const std::string start = text.substr(0, 2);
    if (start == "\xff\xfe" || start == "\xfe\xff" || start.find('\0') != std::string::npos) {
        return false;
    }
    const std::string declaration = text.substr(0, text.find('>'));
    return !boost::algorithm::icontains(declaration, "iso-8859-1") && !boost::algorithm::icontains(declaration, "us-ascii");
}

// Whether the XML is refused for its encoding: its name, a character that the end of the file cuts off, or bytes that are not
// UTF-8. The latter make an invalid token, as other mistakes do. If one of those comes first, the text before the bytes has it too.
bool IsWrongEncoding(const std::string& reason, const std::string& text)
{
    if (reason.find("encoding") != std::string::npos || reason == "partial character") {
        return true;
    }
    const std::size_t invalid = TUtf8::FindInvalid(text);
    return reason == kInvalidToken && invalid < text.size() && IsMeantAsUtf8(text) &&
           TXmlReason().Find(text.substr(0, invalid)) != kInvalidToken;
}

}  // namespace

TRulesParser::TRulesParser(boost::shared_ptr<ICIMNamespace> schema) : TDiffXMLParser(std::move(schema)) {}

void TRulesParser::Read(const TRulesText& rules)
{
    const TLogCapture log;  // the fault says the same in the client's words
    std::string text = rules.text;
    try {
        Parse(text.data(), text.size());
    } catch (const TZELException& error) {
        ThrowIfOutOfMemory(error);
        if (fFault.kind == TRulesFault::kMalformed && IsWrongEncoding(fFault.text, rules.text)) {
            fFault.kind = TRulesFault::kWrongEncoding;
        }
        throw TClientError(fFault.Describe(rules.name));
    }
}

bool TRulesParser::IsInRoot() const
{
    return fStateStack.size() == kInRoot;
}

bool TRulesParser::IsInValue() const
{
    return fStateStack.size() == kInValue;
}

void TRulesParser::StartElement(const char* name, TAttributes& attrs)
{
    const std::size_t depth = fStateStack.size();
    try {
        TDiffXMLParser::StartElement(name, attrs);
    } catch (const TZELException& error) {
        if (fStateStack.size() == depth) {
            NoteFault(error.what(), MakeFault(TRulesFault::kUnexpectedElement, name));
        } else {
            NoteFault(error.what(), fStateStack.size() == kInRoot ? FindRootFault(attrs) : FindClassFault(attrs));
        }
        throw;
    }
    if (fStateStack.size() > depth) {
        NoteStart(name, attrs.count("default") != 0);
    }
}

void TRulesParser::EndElement(const char* name)
{
    const bool isValue = IsInValue();
    const std::string text = isValue ? fCharData : std::string();  // before the plug-in clears it
    try {
        TDiffXMLParser::EndElement(name);
    } catch (const TZELException& error) {
        NoteFault(error.what(), MakeFault(TRulesFault::kUnknownProperty, text));
        throw;
    }
    if (isValue) {
        fDocument.elements.back().listed.push_back({text, fTreatment, GetCurLine()});
    }
}

// Called for malformed XML, and by the plug-in for everything that it refuses. The callers above describe the latter better.
void TRulesParser::FatalError(const char* message)
{
    fFault = MakeFault(TRulesFault::kMalformed, message);
    fFault.line = GetCurLine();
    TDiffXMLParser::FatalError(message);
}

void TRulesParser::NoteStart(const std::string& name, bool hasDefault)
{
    if (fStateStack.size() == kInClass) {
        fDocument.elements.push_back(
            {fCurrentRules->fClassName, fCurrentRules->fDefault, fCurrentRules->fExcludedKeys, GetCurLine(), {}, hasDefault});
    } else if (fStateStack.size() == kInList) {
        fTreatment = name == "includelist" ? TCIMDiffEngine::INCLUDE : TCIMDiffEngine::EXCLUDE;
    }
}

void TRulesParser::NoteFault(const char* reason, const TRulesFault& fault)
{
    // An exception that does not come from FatalError comes from the schema.
    if (fFault.kind == TRulesFault::kSchemaFailed) {
        fFault.text = reason;
        return;
    }
    fFault.kind = fault.kind;
    fFault.text = fault.text;
    if (fStateStack.size() >= kInClass) {
        fFault.className = fCurrentRules->fClassName;
    }
}

}  // namespace NORVZEL20
