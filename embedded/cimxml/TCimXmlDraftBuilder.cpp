// Drafts: classes and instances as the document describes them, before the namespace knows them.
//
// A draft is a TEmbeddedObject with the places of its parts in the document, for messages that come only when the draft is used.
// Classes always become drafts, because their superclass may come later. Instances become drafts if their class is not declared
// yet, and inside of embedded objects, which belong to no namespace.
//
// Elements nest (class, property or method, parameter, qualifier). The builder keeps the innermost open one of each kind, and moves
// it into the one around it when it ends. A qualifier goes to the innermost element that is open.
#include "embedded/cimxml/TCimXmlDraftBuilder.h"

#include <utility>

#include "embedded/load/MessageText.h"
#include "embedded/store/TSchemaLimits.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

using EStatus = TZELStatusCode::EStatusCode;
using TType = TCIMValue::TCIMType;

void TCimXmlDraftBuilder::BeginClass(const TCimXmlAttributes& attributes)
{
    fDraft.emplace(TDraft{TEmbeddedObject(attributes.Require("NAME"), true), fContext.GetPlace(), {}, {}});
    fDraft->object.SetSuperClassName(attributes.Get("SUPERCLASS"));
}

void TCimXmlDraftBuilder::BeginInstance(const char* className)
{
    fDraft.emplace(TDraft{TEmbeddedObject(className, false), fContext.GetPlace(), {}, {}});
}

TDraft TCimXmlDraftBuilder::Take()
{
    TDraft draft = std::move(*fDraft);
    fDraft.reset();
    return draft;
}

/// Fails if there are as many as there may be.
void TCimXmlDraftBuilder::CheckRoom(std::size_t count, std::size_t most, const char* what) const
{
    if (count >= most) {
        fContext.Fail(EStatus::kParseError, "found more than " + std::to_string(most) + " " + what + " in " +
                                                (fDraft->object.IsClass() ? "class " : "an instance of class ") +
                                                Quote(fDraft->object.GetClassName()) + "; split it");
    }
}

void TCimXmlDraftBuilder::BeginProperty(const char* name, const TCimXmlAttributes& attributes)
{
    CheckRoom(fDraft->object.GetProperties().size(), TSchemaLimits::kMaxProperties, "properties");
    if (fDraft->object.FindProperty(name) != nullptr) {
        fContext.Fail(EStatus::kParseError, DescribeSecondProperty(name, fDraft->object.IsClass() ? "class" : "instance"));
    }
    fPropertyPlace = fContext.GetPlace();
    fProperty.emplace();
    fProperty->name = name;
    fProperty->referenceClass = attributes.Get("REFERENCECLASS");
    fProperty->arraySize = ReadArraySize(attributes);
    fProperty->classOrigin = attributes.Get("CLASSORIGIN");
    fProperty->propagated = attributes.IsTrue("PROPAGATED", false);
}

void TCimXmlDraftBuilder::EndProperty(TCIMValue value)
{
    fProperty->value = std::move(value);
    fDraft->object.AddProperty(std::move(*fProperty));
    fDraft->propertyPlaces.push_back(fPropertyPlace);
    fProperty.reset();
}

void TCimXmlDraftBuilder::AddBadValue(TBadValue bad)
{
    bad.property = fDraft->object.GetProperties().size();
    fDraft->badValues.push_back(std::move(bad));
}

void TCimXmlDraftBuilder::BeginMethod(const TCimXmlAttributes& attributes)
{
    const char* typeName = attributes.Find("TYPE");
    const TType type = typeName != nullptr ? attributes.ReadType(typeName) : TType(TType::kNone);
    const char* name = attributes.Require("NAME");
    CheckRoom(fDraft->object.GetMethods().size(), TSchemaLimits::kMaxMethods, "methods");
    fMethod.emplace();
    fMethod->name = name;
    fMethod->type = type;
    fMethod->classOrigin = attributes.Get("CLASSORIGIN");
    fMethod->propagated = attributes.IsTrue("PROPAGATED", false);
}

void TCimXmlDraftBuilder::EndMethod()
{
    fDraft->object.AddMethod(std::move(*fMethod));
    fMethod.reset();
}

void TCimXmlDraftBuilder::BeginParameter(const TCimXmlAttributes& attributes)
{
    const TCimXmlElement::EElement element = attributes.GetElement();
    const bool isReference = element == TCimXmlElement::kParameterReference || element == TCimXmlElement::kParameterRefArray;
    const bool isArray = element == TCimXmlElement::kParameterArray || element == TCimXmlElement::kParameterRefArray;
    const TType type = isReference ? TType(TType::kReference) : attributes.RequireType();
    const char* name = attributes.Require("NAME");
    fParameter.emplace();
    fParameter->name = name;
    fParameter->type = isArray ? type.GetArrayType() : type;
    fParameter->referenceClass = attributes.Get("REFERENCECLASS");
    fParameter->arraySize = ReadArraySize(attributes);
}

void TCimXmlDraftBuilder::EndParameter()
{
    fMethod->parameters.push_back(std::move(*fParameter));
    fParameter.reset();
}

/// Innermost first: a parameter is open inside of a method, and a property or a method inside of the class.
void TCimXmlDraftBuilder::AddQualifier(TEmbeddedObject::TQualifier qualifier)
{
    const auto& there = fParameter  ? fParameter->qualifiers
                        : fMethod   ? fMethod->qualifiers
                        : fProperty ? fProperty->qualifiers
                                    : fDraft->object.GetQualifiers();
    CheckRoom(there.size(), TSchemaLimits::kMaxQualifiers, "qualifiers on one element");
    if (fParameter) {
        fParameter->qualifiers.push_back(std::move(qualifier));
    } else if (fMethod) {
        fMethod->qualifiers.push_back(std::move(qualifier));
    } else if (fProperty) {
        fProperty->qualifiers.push_back(std::move(qualifier));
    } else {
        fDraft->object.AddQualifier(std::move(qualifier));
    }
}

/// 0 for an array without a fixed size, and for what is no array.
unsigned int TCimXmlDraftBuilder::ReadArraySize(const TCimXmlAttributes& attributes) const
{
    const char* text = attributes.Find("ARRAYSIZE");
    if (text == nullptr) {
        return 0;
    }
    TCIMValue size;
    if (!TValueText::Parse(TType::kUint32, text, size)) {
        fContext.Fail(EStatus::kParseError, "found the array size " + Quote(text) + ", expected a number");
    }
    return static_cast<unsigned int>(size.GetUnsigned());
}

}  // namespace NORVZEL20
