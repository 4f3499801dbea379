// Properties of instances are what a document mostly consists of.
//
// An instance whose class is declared is filled without a draft: a property goes straight to its slot, and its declared type spares
// looking up the name of its type. The start tags are few and come again and again. So what a tag means (slot, type, whether text
// may be an embedded object) is found once for each class in a row that has such a property. A tag that stands in instances of two
// classes in turn, as one for an inherited property does, is looked up anew.
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

/// In a draft, unmarked text stays text: its class is not known yet (see TCimXmlInstanceBuilder::Fill).
void TCimXmlPropertyReader::BeginInDraft(const TCimXmlAttributes& attributes)
{
    fDraft.BeginProperty(attributes.Require("NAME"), attributes);
    const TType type = ReadType(attributes, TType::kNone);
    fItem.Begin(fDraft.GetPropertyName(), type, GetText(attributes, type, false));
}

void TCimXmlPropertyReader::BeginInInstance(const TCimXmlAttributes& attributes)
{
    fTarget = fLoader->FindProperty(attributes.Require("NAME"));
    const TType type = ReadType(attributes, fTarget.type);
    fItem.Begin(*fTarget.name, type, GetText(attributes, type, fTarget.isEmbedded));
}

void TCimXmlPropertyReader::BeginInInstance(std::size_t number, const TCimXmlAttributes& attributes)
{
    if (number >= fKnown.size()) {
        fKnown.resize(number + 1);
    }
    TKnown& known = fKnown[number];
    if (known.layout == fLoader->GetLayout() && fLoader->TakeSlot(known.target.slot)) {
        fTarget = known.target;
        fItem.Begin(*fTarget.name, known.type, known.text);
        return;
    }
    BeginInInstance(attributes);
    known = {fLoader->GetLayout(), fTarget, fItem.GetType(), fItem.GetText()};
}

/// A new instance has nulls already, apart from what it shares with others.
void TCimXmlPropertyReader::EndInInstance()
{
    if (!fItem.IsNull() || fTarget.isStatic) {
        fLoader->SetProperty(fTarget, fItem.Take(), fPaths.TakeMetUnsettled());
    }
}

TCimXmlItem::EText TCimXmlPropertyReader::GetText(const TCimXmlAttributes& attributes, TType type, bool isDeclaredEmbedded)
{
    if (type.GetElementType() != TType::kString) {
        return TCimXmlItem::kPlain;
    }
    if (IsMarkedEmbedded(attributes)) {
        return TCimXmlItem::kObject;
    }
    return isDeclaredEmbedded ? TCimXmlItem::kPerhapsObject : TCimXmlItem::kPlain;
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
