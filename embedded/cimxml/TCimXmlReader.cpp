#include "embedded/cimxml/TCimXmlReader.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <cstring>
#include <utility>

#include "embedded/cimxml/MessageText.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

using EStatus = TZELStatusCode::EStatusCode;
using TType = TCIMValue::TCIMType;

namespace {

constexpr std::size_t kMaxEmbeddedDepth = 32;

bool IsBlank(char c)
{
    return c == ' ' || c == '\n' || c == '\t' || c == '\r';
}

/// Whether text that may be an embedded object is one: writers that do not mark those write plain text beside them.
bool LooksLikeObject(std::string_view text)
{
    const auto start = std::find_if_not(text.begin(), text.end(), IsBlank);
    return start != text.end() && *start == '<';
}

bool IsMarkedEmbedded(const TCimXmlAttributes& attributes)
{
    return attributes.Find("EmbeddedObject") != nullptr || attributes.Find("EMBEDDEDOBJECT") != nullptr;
}

}  // namespace

/// Reads the text of embedded objects; kept between them, because a parser is dear to make.
class TCimXmlReader::TEmbedded {
  public:
    TEmbedded(TCimXmlContext& context, const boost::shared_ptr<TInMemNamespace>& ns)
        : fContext(context), fSink(context, ns, nullptr), fXml(fSink)
    {
        // Each text within a text would have entities of its own to expand, each to the limit of a whole document.
        fXml.RefuseDocumentTypes();
    }

    boost::shared_ptr<const TEmbeddedObject> Read(std::string_view text)
    {
        fSink.Reset();
        fXml.Reset("UTF-8");
        if (!fXml.Parse(text.data(), text.size(), true)) {
            fContext.Fail(EStatus::kTypeMismatch,
                          "found " + Quote(text) + ", expected an <INSTANCE> or a <CLASS> (" + fXml.GetError() + ")");
        }
        return fSink.TakeObject();
    }

    bool TakeMetUnknownClass() noexcept { return fSink.fPaths.TakeMetUnknownClass(); }

  private:
    TCimXmlContext& fContext;
    TCimXmlReader fSink;
    TXmlReader fXml;
};

TCimXmlReader::TCimXmlReader(TCimXmlContext& context, boost::shared_ptr<TInMemNamespace> ns, TCimXmlLoader* loader)
    : fContext(context), fNamespace(ns), fLoader(loader), fPaths(context, std::move(ns)), fDraft(context)
{
    Reset();
}

TCimXmlReader::~TCimXmlReader() = default;

void TCimXmlReader::Reset()
{
    fOpen.assign(1, {fLoader != nullptr ? TTable::kStart : TTable::kEmbedded, TElement::kUnknown});
    fText = std::string_view();
    fObject.reset();
}

boost::shared_ptr<const TEmbeddedObject> TCimXmlReader::TakeObject()
{
    return std::exchange(fObject, boost::shared_ptr<const TEmbeddedObject>());
}

void TCimXmlReader::OnStart(const char* name, const char** attributes)
{
    CheckBlank();
    const TElement::EElement element = TElement::Find(name);
    const TTable::TStep step = TTable::Find(GetState(), element);
    if (step.action == TTable::kRefuse) {
        FailUnexpected(name);
    }
    fOpen.push_back({step.next, element});
    fText = std::string_view();
    fContext.Guard([&] { Begin(step.action, TCimXmlAttributes(attributes)); });
}

void TCimXmlReader::OnEnd(const char*)
{
    CheckBlank();
    const TTable::EAction action = TTable::GetEndAction(GetState());
    fOpen.pop_back();
    fContext.Guard([&] { End(action); });
    fText = std::string_view();
}

/// Text where only elements may stand must be white space.
void TCimXmlReader::CheckBlank() const
{
    if (fText.empty() || TTable::TakesText(GetState())) {
        return;
    }
    if (!std::all_of(fText.begin(), fText.end(), IsBlank)) {
        fContext.Fail(EStatus::kParseError, "found text " + Quote(fText) + " in <" + TElement::GetName(fOpen.back().element) +
                                                ">, expected elements alone");
    }
}

void TCimXmlReader::Begin(TTable::EAction action, const TCimXmlAttributes& attributes)
{
    switch (action) {
    case TTable::kBeginProperty:
        return BeginProperty(attributes);
    case TTable::kBeginText:
        return BeginValue();
    case TTable::kBeginArray:
        return BeginArray();
    case TTable::kAddNull:
        return fElements.push_back(TCIMValue::Null(fItem->type.GetElementType()));
    case TTable::kBeginInstance:
        return BeginInstance(attributes);
    case TTable::kBeginObject:
        return BeginObject();
    case TTable::kBeginReference:
        return fPaths.Begin();
    case TTable::kReadClassName:
        return fPaths.SetClassName(Require(attributes, fOpen.back().element == TElement::kClassName ? "NAME" : "CLASSNAME"));
    case TTable::kBeginKeyBinding:
        return fPaths.BeginKeyBinding(Require(attributes, "NAME"));
    case TTable::kBeginKeyValue:
        return fPaths.BeginKeyValue(attributes);
    case TTable::kBeginNamespacePath:
        return fPaths.BeginNamespacePath();
    case TTable::kReadNamespace:
        return fPaths.AddNamespace(Require(attributes, "NAME"));
    default:
        return BeginDeclared(action, attributes);
    }
}

void TCimXmlReader::End(TTable::EAction action)
{
    switch (action) {
    case TTable::kEndText:
        return EndText();
    case TTable::kEndProperty:
        return EndProperty();
    case TTable::kEndArray:
        return EndArray();
    case TTable::kEndInstance:
        return EndInstance();
    case TTable::kEndObject:
        return EndObject();
    case TTable::kEndReference:
        return EndReference();
    case TTable::kEndKeyValue:
        return fPaths.EndKeyValue(fText);
    case TTable::kEndKeyBinding:
        return fPaths.EndKeyBinding();
    case TTable::kEndHost:
        return fPaths.SetHost(fText);
    case TTable::kEndNamespacePath:
        if (GetState() != TTable::kNamespacePath) {  // there it ends with the host's part
            fPaths.EndNamespacePath();
        }
        return;
    default:
        return EndDeclared(action);
    }
}

void TCimXmlReader::BeginObject()
{
    fObjectGiven = false;
    fPaths.Begin();
}

void TCimXmlReader::EndObject()
{
    if (!fObjectGiven) {
        fContext.Fail(EStatus::kParseError, "found an object without contents, expected a <CLASS> or an <INSTANCE> in it");
    }
    fPaths.Drop();
}

/// To be called where a class or an instance starts: an object holds one, and its name tells the namespace.
void TCimXmlReader::NoteObject()
{
    if (fOpen[fOpen.size() - 2].state != TTable::kObject) {
        return;
    }
    if (fObjectGiven) {
        fContext.Fail(EStatus::kParseError, "found a second object where one is expected");
    }
    fObjectGiven = true;
    fPaths.NoteOwnNamespace();
}

void TCimXmlReader::BeginInstance(const TCimXmlAttributes& attributes)
{
    NoteObject();
    const char* name = Require(attributes, "CLASSNAME");
    fDirect = fLoader != nullptr && fLoader->BeginInstance(name);
    if (!fDirect) {
        fDraft.BeginInstance(name);
    }
}

void TCimXmlReader::EndInstance()
{
    const bool isNamed = fLoader != nullptr && fPaths.HasOwnPath();
    if (fDirect) {
        fDirect = false;
        // Only a loader starts an instance directly, so there is one.
        return fLoader->EndInstance(isNamed ? &fPaths.GetOwnKeys() : nullptr);  // NOLINT(clang-analyzer-core.CallAndMessage)
    }
    TCimXmlDraft draft = fDraft.Take();
    if (fLoader == nullptr) {
        fObject = boost::make_shared<const TEmbeddedObject>(std::move(draft.object));
        return;
    }
    if (isNamed) {
        draft.ownKeys = fPaths.GetOwnKeys();
    }
    fLoader->AddInstance(std::move(draft));
}

void TCimXmlReader::BeginItem(TItem& item, std::string_view name, TType type)
{
    item.name = name;
    item.type = type;
    item.text = TItem::kPlain;
    item.isGiven = false;
    fItem = &item;
}

void TCimXmlReader::BeginProperty(const TCimXmlAttributes& attributes)
{
    const char* name = Require(attributes, "NAME");
    if (fDirect) {
        fTarget = fLoader->FindProperty(name);
    } else {
        fDraft.BeginProperty(name, attributes);
    }
    BeginItem(fProperty, fDirect ? *fTarget.name : fDraft.GetPropertyName(), ReadPropertyType(attributes));
    if (fProperty.type.GetElementType() != TType::kString) {
        return;
    }
    if (IsMarkedEmbedded(attributes)) {
        fProperty.text = TItem::kObject;
    } else if (fDirect && fTarget.isEmbedded) {
        fProperty.text = TItem::kPerhapsObject;
    }
}

/// The type that the element tells; looked up only where it is not the declared one.
TType TCimXmlReader::ReadPropertyType(const TCimXmlAttributes& attributes) const
{
    const TElement::EElement element = fOpen.back().element;
    if (element == TElement::kPropertyReference) {
        return TType::kReference;
    }
    if (element == TElement::kPropertyRefArray) {
        return TType::kArrayReference;
    }
    const char* text = Require(attributes, "TYPE");
    const bool isDeclared = fDirect && std::strcmp(text, TValueText::GetTypeName(fTarget.type)) == 0;
    const TType type = isDeclared ? fTarget.type.GetElementType() : ReadType(text);
    return element == TElement::kPropertyArray ? type.GetArrayType() : type;
}

void TCimXmlReader::EndProperty()
{
    if (!fDirect) {
        return fDraft.EndProperty(TakeValue(fProperty));
    }
    if (!fProperty.value.IsNull()) {
        fLoader->SetProperty(fTarget, std::move(fProperty.value), fPaths.TakeMetUnknownClass());
    }
    fProperty.value = TCIMValue();
}

void TCimXmlReader::BeginValue()
{
    if (fOpen[fOpen.size() - 2].state == TTable::kArray) {
        return;
    }
    if (fItem->isGiven) {
        fContext.Fail(EStatus::kParseError, "found a second value for " + Quote(fItem->name) + ", expected one");
    }
    fItem->isGiven = true;
}

void TCimXmlReader::BeginArray()
{
    BeginValue();
    fElements.clear();
    if (GetState() == TTable::kReferenceArray && fItem->type.GetElementType() != TType::kReference) {
        fContext.Fail(EStatus::kTypeMismatch, "found an array of references as value of " + Quote(fItem->name) + ", expected a " +
                                                  TValueText::DescribeType(fItem->type.GetArrayType()));
    }
}

/// What a value belongs to is the innermost element that is open when it has ended.
void TCimXmlReader::EndText()
{
    if (GetState() != TTable::kArray) {
        return MakeValue(fText, fItem->value);
    }
    fElements.emplace_back();
    MakeValue(fText, fElements.back());
}

void TCimXmlReader::EndReference()
{
    TCIMValue path(fPaths.End());
    switch (GetState()) {
    case TTable::kReferenceArray:
        return fElements.push_back(std::move(path));
    case TTable::kKeyBinding:
    case TTable::kInstanceName:
        return fPaths.AddKey(std::move(path));
    default:
        fItem->value = std::move(path);
    }
}

void TCimXmlReader::EndArray()
{
    fItem->type = fItem->type.GetArrayType();
    fItem->value = TCIMValue(fItem->type, static_cast<unsigned int>(fElements.size()), fElements);
    fElements.clear();
}

TCIMValue TCimXmlReader::TakeValue(TItem& item)
{
    TCIMValue value = item.value.IsNull() ? TCIMValue::Null(item.type) : std::move(item.value);
    item.value = TCIMValue();
    return value;
}

void TCimXmlReader::MakeValue(std::string_view text, TCIMValue& value)
{
    const TType type = fItem->type.GetElementType();
    if (type == TType::kString) {
        value = IsObject(text) ? MakeObject(text) : fContext.GetTexts().MakeValue(text);
    } else if (!TValueText::Parse(type, text, value)) {
        fContext.Fail(EStatus::kTypeMismatch, "found " + Quote(text) + " as value of " + Quote(fItem->name) + ", expected a " +
                                                  TValueText::GetTypeName(type));
    }
}

bool TCimXmlReader::IsObject(std::string_view text) const
{
    if (fItem->text == TItem::kPerhapsObject) {
        return LooksLikeObject(text);
    }
    return fItem->text == TItem::kObject && !text.empty();
}

TCIMValue TCimXmlReader::ReadObjects(const TCIMValue& value)
{
    if (value.IsNull()) {
        return value;
    }
    if (value.GetType().IsArray()) {
        std::vector<TCIMValue> elements;
        for (const TCIMValue& element : value.GetElements()) {
            elements.push_back(ReadObjects(element));
        }
        return TCIMValue(value.GetType(), static_cast<unsigned int>(elements.size()), elements);
    }
    return TValueAccess::IsText(value) && LooksLikeObject(value.GetString()) ? MakeObject(value.GetString()) : value;
}

TCIMValue TCimXmlReader::MakeObject(std::string_view text)
{
    if (fContext.fEmbeddedDepth == kMaxEmbeddedDepth) {
        fContext.Fail(EStatus::kParseError, "embedded objects are nested too deeply");
    }
    if (!fEmbedded) {
        fEmbedded = std::make_unique<TEmbedded>(fContext, fNamespace);
    }
    ++fContext.fEmbeddedDepth;
    TCIMValue value(fEmbedded->Read(text));
    --fContext.fEmbeddedDepth;
    if (fEmbedded->TakeMetUnknownClass()) {
        fPaths.NoteUnknownClass();
    }
    return value;
}

}  // namespace NORVZEL20
