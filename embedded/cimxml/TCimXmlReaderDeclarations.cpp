#include "embedded/cimxml/TCimXmlReader.h"

#include <boost/smart_ptr/make_shared.hpp>
#include <utility>

#include "embedded/cimxml/MessageText.h"
#include "embedded/value/TValueText.h"

// What TCimXmlReader does for declarations and for the frames of messages, and what it says of what it cannot read.
namespace NORVZEL20 {

using EStatus = TZELStatusCode::EStatusCode;
using TType = TCIMValue::TCIMType;

/// The actions of declarations and messages, which are rarer.
void TCimXmlReader::BeginDeclared(TTable::EAction action, const TCimXmlAttributes& attributes)
{
    switch (action) {
    case TTable::kBeginClass:
        return BeginClass(attributes);
    case TTable::kBeginMethod:
        return BeginMethod(attributes);
    case TTable::kBeginParameter:
        return BeginParameter(attributes);
    case TTable::kBeginQualifier:
        return BeginQualifier(attributes);
    case TTable::kBeginQualifierDecl:
        return BeginQualifierDecl(attributes);
    case TTable::kReadScope:
        return ReadScope(attributes);
    case TTable::kReadError:
        return ReadError(attributes);
    case TTable::kSkip:
        return NoteSkipped();
    default:
        return;
    }
}

void TCimXmlReader::EndDeclared(TTable::EAction action)
{
    switch (action) {
    case TTable::kEndClass:
        return EndClass();
    case TTable::kEndMethod:
        return fDraft.EndMethod();
    case TTable::kEndParameter:
        return fDraft.EndParameter();
    case TTable::kEndQualifier:
        return EndQualifier();
    case TTable::kEndQualifierDecl:
        return EndQualifierDecl();
    default:
        return;
    }
}

void TCimXmlReader::BeginClass(const TCimXmlAttributes& attributes)
{
    NoteObject();
    fDraft.BeginClass(Require(attributes, "NAME"), attributes.Get("SUPERCLASS"));
}

void TCimXmlReader::EndClass()
{
    TCimXmlDraft draft = fDraft.Take();
    if (fLoader == nullptr) {
        fObject = boost::make_shared<const TEmbeddedObject>(std::move(draft.object));
        return;
    }
    const TCimXmlContext::TAt at(fContext, draft.place);
    fLoader->AddClass(std::move(draft));
}

void TCimXmlReader::BeginMethod(const TCimXmlAttributes& attributes)
{
    const char* type = attributes.Find("TYPE");
    fDraft.BeginMethod(Require(attributes, "NAME"), type != nullptr ? ReadType(type) : TType(TType::kNone), attributes);
}

void TCimXmlReader::BeginParameter(const TCimXmlAttributes& attributes)
{
    const TElement::EElement element = fOpen.back().element;
    const bool isReference = element == TElement::kParameterReference || element == TElement::kParameterRefArray;
    const bool isArray = element == TElement::kParameterArray || element == TElement::kParameterRefArray;
    const TType type = isReference ? TType(TType::kReference) : ReadType(Require(attributes, "TYPE"));
    fDraft.BeginParameter(Require(attributes, "NAME"), isArray ? type.GetArrayType() : type, attributes);
}

void TCimXmlReader::BeginQualifier(const TCimXmlAttributes& attributes)
{
    fQualifierName = Require(attributes, "NAME");
    BeginItem(fQualifier, fQualifierName, ReadType(Require(attributes, "TYPE")));
    fFlavor = TCimXmlDraftBuilder::ReadFlavor(attributes);
    fPropagated = attributes.IsTrue("PROPAGATED", false);
}

void TCimXmlReader::EndQualifier()
{
    TCIMValue value = TakeValue(fQualifier);
    fItem = &fProperty;
    if (fDirect) {
        return fContext.Tolerate("qualifier of an instance",
                                 "qualifier " + Quote(fQualifier.name) + " stands on an instance or its property; left out");
    }
    fDraft.AddQualifier({fQualifierName, std::move(value), fFlavor, fPropagated});
}

void TCimXmlReader::BeginQualifierDecl(const TCimXmlAttributes& attributes)
{
    const TType type = ReadType(Require(attributes, "TYPE"));
    fQualifierName = Require(attributes, "NAME");
    BeginItem(fQualifier, fQualifierName, attributes.IsTrue("ISARRAY", false) ? type.GetArrayType() : type);
    fFlavor = TCimXmlDraftBuilder::ReadFlavor(attributes);
    fScope = 0;
}

void TCimXmlReader::ReadScope(const TCimXmlAttributes& attributes)
{
    static constexpr std::pair<const char*, ICIMQualifierDecl::EScope> kScopes[] = {
        {"CLASS", ICIMQualifierDecl::kScopeClass},           {"ASSOCIATION", ICIMQualifierDecl::kScopeAssociation},
        {"INDICATION", ICIMQualifierDecl::kScopeIndication}, {"PROPERTY", ICIMQualifierDecl::kScopeProperty},
        {"REFERENCE", ICIMQualifierDecl::kScopeReference},   {"METHOD", ICIMQualifierDecl::kScopeMethod},
        {"PARAMETER", ICIMQualifierDecl::kScopeParameter},   {"ANY", ICIMQualifierDecl::kScopeAny}};
    for (const auto& [name, scope] : kScopes) {
        if (attributes.IsTrue(name, false)) {
            fScope |= scope;
        }
    }
}

void TCimXmlReader::EndQualifierDecl()
{
    TCimXmlQualifierDraft draft;
    draft.name = fQualifierName;
    draft.value = TakeValue(fQualifier);
    draft.scope = ICIMQualifierDecl::EScope(fScope);
    draft.flavor = fFlavor;
    fLoader->AddQualifierDecl(draft);
}

void TCimXmlReader::ReadError(const TCimXmlAttributes& attributes) const
{
    fContext.Fail(EStatus::kParseError, std::string("found a response with error ") + attributes.Get("CODE") + " (" +
                                            Quote(attributes.Get("DESCRIPTION")) + "), expected one with objects");
}

void TCimXmlReader::NoteSkipped()
{
    const char* name = TElement::GetName(fOpen.back().element);
    fContext.Tolerate(name, std::string("<") + name + "> holds no class or instance; left out");
}

void TCimXmlReader::FailUnexpected(const char* name) const
{
    const TOpen& open = fOpen.back();
    const std::string place = open.element == TElement::kUnknown ? " as the outermost element"
                                                                 : std::string(" in <") + TElement::GetName(open.element) + ">";
    const std::string shown = Quote(name);
    fContext.Fail(EStatus::kParseError, "found element <" + shown.substr(1, shown.size() - 2) + ">" + place + ", expected " +
                                            TTable::DescribeExpected(open.state));
}

const char* TCimXmlReader::Require(const TCimXmlAttributes& attributes, const char* name) const
{
    const char* value = attributes.Find(name);
    if (value == nullptr || *value == '\0') {
        fContext.Fail(EStatus::kParseError, std::string("found <") + TElement::GetName(fOpen.back().element) + "> without " + name +
                                                ", expected that attribute with a value");
    }
    return value;
}

TType TCimXmlReader::ReadType(const char* text) const
{
    const TType type = TValueText::FindType(text);
    if (type == TType::kNone) {
        fContext.Fail(EStatus::kParseError, "found type " + Quote(text) + ", expected a CIM type such as string or uint32");
    }
    return type;
}

}  // namespace NORVZEL20
