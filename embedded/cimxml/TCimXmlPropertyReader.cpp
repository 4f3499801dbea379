// Properties of instances are what a document mostly consists of.
//
// An instance whose class is declared is filled without a draft: a property goes straight to its slot, and its declared type spares
// looking up the name of its type. The start tags are few and come again and again. So it is noted for each property of a class
// which tag it had last, and what that tag means (type, whether text may be an embedded object). If the tag of the property that is
// likely to come next is the one noted, nothing is looked up and no name compared.
#include "embedded/cimxml/TCimXmlPropertyReader.h"

#include <cstring>

#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

/// Servers write the attribute in either letter case, some of them both.
bool IsMarkedEmbedded(const TCimXmlAttributes& attributes)
{
    return attributes.Find("EmbeddedObject") != nullptr || attributes.Find("EMBEDDEDOBJECT") != nullptr;
}

}  // namespace

/// In a draft, unmarked text stays text: its class is not known yet (see TInstanceBuilder::Fill).
void TCimXmlPropertyReader::BeginInDraft(const TCimXmlAttributes& attributes)
{
    fDraft.BeginProperty(attributes.Require("NAME"), attributes);
    const TType type = ReadType(attributes, TType::kNone);
    fItem.Begin(fDraft.GetPropertyName(), type, GetText(attributes, type, false));
}

void TCimXmlPropertyReader::EndInDraft()
{
    fDraft.EndProperty(fItem.IsBad() ? SettleInDraft(fItem.TakeBad()) : fItem.Take());
}

/// The loader settles those of its instances, when their classes are declared. Embedded objects and default values of classes never
/// come there; a default value stands for the property's type, so it cannot be text.
TCIMValue TCimXmlPropertyReader::SettleInDraft(TBadValue bad)
{
    const bool isClass = fDraft.GetObject().IsClass();
    if (fLoader != nullptr && !isClass) {
        fDraft.AddBadValue(std::move(bad));
        return TCIMValue::Null(fItem.GetType());
    }
    fContext.NoteBadValue(bad, fDraft.GetObject().GetClassName(), fDraft.GetPropertyName(), fLoader == nullptr);
    return isClass || fContext.GetOptions().badValues != EBadValues::kText ? TCIMValue::Null(fItem.GetType()) : bad.value;
}

void TCimXmlPropertyReader::BeginInInstance(const TCimXmlAttributes& attributes)
{
    fTarget = &fLoader->FindProperty(attributes.Require("NAME"));
    const TType type = ReadType(attributes, fTarget->type);
    fItem.Begin(*fTarget->name, type, GetText(attributes, type, fTarget->isEmbedded));
}

void TCimXmlPropertyReader::BeginInInstance(std::uint64_t number, const TCimXmlAttributes& attributes)
{
    if (TLoadTarget* const target = fLoader->TakeLikely(number)) {
        fTarget = target;
        fItem.Begin(*target->name, target->tag.type, target->tag.text);
        return;
    }
    BeginInInstance(attributes);
    fTarget->tag = {number, fItem.GetType(), fItem.GetText()};
}

/// A new instance has nulls already, apart from what it shares with others.
void TCimXmlPropertyReader::EndInInstance()
{
    if (fItem.IsNull()) {
        if (fItem.IsBad()) {
            return EndBad();
        }
        if (!fTarget->isStatic) {
            return;
        }
    }
    const bool isUnsettled = fPaths.TakeMetUnsettled();
    if (isUnsettled || !fLoader->FillProperty(*fTarget, fItem.GetValue())) {
        fLoader->SetProperty(*fTarget, fItem.Take(), isUnsettled);
    }
}

void TCimXmlPropertyReader::EndBad()
{
    fPaths.TakeMetUnsettled();
    fLoader->SetBad(*fTarget, fItem.TakeBad());
}

EValueText TCimXmlPropertyReader::GetText(const TCimXmlAttributes& attributes, TType type, bool isDeclaredEmbedded)
{
    if (type.GetElementType() != TType::kString) {
        return EValueText::kPlain;
    }
    if (IsMarkedEmbedded(attributes)) {
        return EValueText::kObject;
    }
    return isDeclaredEmbedded ? EValueText::kPerhapsObject : EValueText::kPlain;
}

/// The type that the element gives. If that is the declared one, as it mostly is, its name need not be looked up.
TCIMValue::TCIMType TCimXmlPropertyReader::ReadType(const TCimXmlAttributes& attributes, TType declared)
{
    const TCimXmlElement::EElement element = attributes.GetElement();
    if (element == TCimXmlElement::kPropertyReference) {
        return TType::kReference;
    }
    if (element == TCimXmlElement::kPropertyRefArray) {
        return TType::kArrayReference;
    }
    const char* text = attributes.Require("TYPE");
    const bool isDeclared = declared != TType::kNone && std::strcmp(text, TValueText::GetTypeName(declared)) == 0;
    const TType type = isDeclared ? declared.GetElementType() : attributes.ReadType(text);
    return element == TCimXmlElement::kPropertyArray ? type.GetArrayType() : type;
}

}  // namespace NORVZEL20
