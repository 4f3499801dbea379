// From XML events to classes and instances.
//
// The reader keeps a stack of open elements, each with its state. When an element starts, TCimXmlTable says by the state and the
// element which state comes next and which action to do; when it ends, the state alone says the action. The actions put together:
//
//     object paths             TCimXmlPathReader
//     properties               TCimXmlPropertyReader
//     qualifiers               TCimXmlQualifierReader
//     values of both           TCimXmlItem
//     embedded objects         TCimXmlObjectReader, which runs another reader over the value's text
//     classes, instances       TCimXmlDraftBuilder
//
// What is complete goes to the loader. There is a short cut for what inventories are made of: an instance whose class is declared
// needs no draft; the loader allocates it at once, and each property goes straight to its slot. Tags that come again have a number,
// by which their element is found.
#include "embedded/cimxml/TCimXmlReader.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <utility>

#include "embedded/cimxml/TXmlCharacter.h"
#include "embedded/load/MessageText.h"

namespace NORVZEL20 {

namespace {

using EStatus = TZELStatusCode::EStatusCode;

}  // namespace

TCimXmlReader::TCimXmlReader(TLoadContext& context, const boost::shared_ptr<const TInMemNamespace>& ns, TLoader* loader,
                             TXmlReader::EParser parser)
    : fContext(context), fLoader(loader), fPaths(context, ns), fObjects(context, ns, fPaths, parser), fDraft(context),
      fAnswer(context), fProperty(context, fObjects, loader, fPaths, fDraft), fQualifier(context, fObjects),
      fFirstTag(static_cast<std::uint64_t>(context.CountDocuments()) << 32U)
{
    Reset();
}

void TCimXmlReader::Reset()
{
    fOpen.assign(1, {fLoader != nullptr ? TTable::kStart : TTable::kEmbedded, TElement::kUnknown});
    fText = std::string_view();
    fObject.reset();
}

boost::shared_ptr<const TEmbeddedObject> TCimXmlReader::TakeObject() noexcept
{
    return std::exchange(fObject, boost::shared_ptr<const TEmbeddedObject>());
}

void TCimXmlReader::OnStart(const char* name, const char** attributes)
{
    const TElement::EElement element = TElement::Find(name);
    const TTable::EAction action = Enter(name, element);
    fContext.Guard([&] { Begin(action, TCimXmlAttributes(fContext, element, attributes)); });
}

void TCimXmlReader::OnKnownStart(std::size_t number, const char* name, const char** attributes)
{
    if (number >= fKnown.size()) {
        fKnown.resize(number + 1, TElement::kCount);
    }
    TElement::EElement& element = fKnown[number];
    element = element == TElement::kCount ? TElement::Find(name) : element;
    const TTable::EAction action = Enter(name, element);
    const TCimXmlAttributes known(fContext, element, attributes);
    if (action == TTable::kBeginProperty && fIsDirect) {
        fItem = &fProperty.GetItem();
        return fContext.Guard([&] { fProperty.BeginInInstance(fFirstTag + number, known); });
    }
    if (action == TTable::kBeginValue) {
        return fContext.Guard([&] { BeginValue(); });
    }
    fContext.Guard([&] { Begin(action, known); });
}

/// Enters the state of an element that starts, and returns the action for it. The state is entered before the action runs, so an
/// action sees its own element as the open one.
TCimXmlTable::EAction TCimXmlReader::Enter(const char* name, TElement::EElement element)
{
    CheckBlank();
    const TTable::TStep step = TTable::Find(GetState(), element);
    if (step.action == TTable::kRefuse) {
        FailUnexpected(name);
    }
    fOpen.push_back({step.next, element});
    fText = std::string_view();
    return step.action;
}

void TCimXmlReader::OnEnd(const char*)
{
    CheckBlank();
    const TTable::EAction action = TTable::GetEndAction(GetState());
    // The action at the end runs in the state around the element.
    fOpen.pop_back();
    fContext.Guard([&] { End(action); });
    fText = std::string_view();
}

void TCimXmlReader::RequireBlank() const
{
    if (!std::all_of(fText.begin(), fText.end(), TXmlCharacter::IsBlank)) {
        fContext.Fail(EStatus::kParseError, "found text " + Quote(fText) + " in <" + TElement::GetName(fOpen.back().element) +
                                                ">, expected only elements");
    }
}

/// The actions that instances consist of; the others are in BeginRare.
void TCimXmlReader::Begin(TTable::EAction action, const TCimXmlAttributes& attributes)
{
    switch (action) {
    case TTable::kBeginProperty:
        fItem = &fProperty.GetItem();
        return fIsDirect ? fProperty.BeginInInstance(attributes) : fProperty.BeginInDraft(attributes);
    case TTable::kBeginValue:
        return BeginValue();
    case TTable::kBeginArray:
        return fItem->BeginArray(GetState() == TTable::kReferenceArray);
    case TTable::kAddNull:
        return fItem->AddNull();
    case TTable::kBeginInstance:
        return BeginInstance(attributes);
    case TTable::kBeginObject:
        return BeginObject();
    case TTable::kBeginReferenceValue:
        fItem->BeginValue();
        return fPaths.Begin();
    case TTable::kBeginReference:
        return fPaths.Begin();
    case TTable::kReadClassName:
        return fPaths.SetClassName(attributes.Require(attributes.GetElement() == TElement::kClassName ? "NAME" : "CLASSNAME"));
    case TTable::kBeginKeyBinding:
        return fPaths.BeginKeyBinding(attributes.Require("NAME"));
    case TTable::kBeginKeyValue:
        return fPaths.BeginKeyValue(attributes);
    case TTable::kBeginNamespacePath:
        return fPaths.BeginNamespacePath();
    case TTable::kReadNamespace:
        return fPaths.AddNamespace(attributes.Require("NAME"));
    default:
        return BeginRare(action, attributes);
    }
}

void TCimXmlReader::BeginRare(TTable::EAction action, const TCimXmlAttributes& attributes)
{
    switch (action) {
    case TTable::kBeginClass:
        return BeginClass(attributes);
    case TTable::kBeginMethod:
        return fDraft.BeginMethod(attributes);
    case TTable::kBeginParameter:
        return fDraft.BeginParameter(attributes);
    case TTable::kBeginQualifier:
        fItem = &fQualifier.GetItem();
        return fQualifier.Begin(attributes);
    case TTable::kBeginQualifierDecl:
        fItem = &fQualifier.GetItem();
        return fQualifier.BeginDecl(attributes);
    case TTable::kReadScope:
        return fQualifier.ReadScope(attributes);
    case TTable::kBeginAnswer:
        return fAnswer.Begin(attributes);
    case TTable::kBeginOutput:
        return fAnswer.BeginOutput(attributes);
    case TTable::kRefuseError:
        fAnswer.RefuseError(attributes);
    case TTable::kRefuseRequest:
        fAnswer.RefuseRequest(attributes);
    case TTable::kSkip:
        return fAnswer.Skip(attributes);
    default:
        return;
    }
}

void TCimXmlReader::End(TTable::EAction action)
{
    switch (action) {
    case TTable::kEndText:
        return EndText();
    case TTable::kEndProperty:
        return fIsDirect ? fProperty.EndInInstance() : fProperty.EndInDraft();
    case TTable::kEndArray:
        return fItem->EndArray();
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
        if (GetState() != TTable::kNamespacePath) {  // a LOCALNAMESPACEPATH in a NAMESPACEPATH is only its second part
            fPaths.EndNamespacePath();
        }
        return;
    default:
        return EndRare(action);
    }
}

void TCimXmlReader::EndRare(TTable::EAction action)
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
    case TTable::kEndAnswer:
        return fAnswer.End();
    case TTable::kEndOutput:
        return fAnswer.EndOutput(fText);
    case TTable::kEndQualifierDecl:
        return fLoader->AddQualifierDecl(fQualifier.TakeDecl());
    default:
        return;
    }
}

void TCimXmlReader::BeginObject()
{
    fIsObjectGiven = false;
    fPaths.Begin();
}

void TCimXmlReader::EndObject()
{
    if (!fIsObjectGiven) {
        fContext.Fail(EStatus::kParseError, "found an object without contents, expected a <CLASS> or an <INSTANCE> in it");
    }
    fPaths.Drop();
}

/// Call this when a class or an instance starts: a VALUE.OBJECT holds one, of the class and in the namespace that the name in
/// front of it says.
void TCimXmlReader::NoteObject(const char* className)
{
    if (GetOuterState() != TTable::kObject) {
        return;
    }
    if (fIsObjectGiven) {
        fContext.Fail(EStatus::kParseError, "found a second object where one is expected");
    }
    fIsObjectGiven = true;
    fPaths.CheckOwnClass(className);
    fPaths.NoteOwnNamespace();
}

void TCimXmlReader::BeginClass(const TCimXmlAttributes& attributes)
{
    NoteObject(attributes.Require("NAME"));
    fDraft.BeginClass(attributes);
}

void TCimXmlReader::EndClass()
{
    TDraft draft = fDraft.Take();
    if (KeepObject(draft)) {
        return;
    }
    const TLoadContext::TAt at(fContext, draft.place);
    fLoader->AddClass(std::move(draft));
}

void TCimXmlReader::BeginInstance(const TCimXmlAttributes& attributes)
{
    const char* name = attributes.Require("CLASSNAME");
    NoteObject(name);
    fIsDirect = fLoader != nullptr && fLoader->BeginInstance(name);
    fPaths.TakeMetUnsettled();  // what was read in front of the instance is none of its properties
    if (!fIsDirect) {
        fDraft.BeginInstance(name);
    }
}

void TCimXmlReader::EndInstance()
{
    const bool isNamed = fLoader != nullptr && fPaths.HasOwnPath();
    if (fIsDirect) {
        fIsDirect = false;
        // Only a loader starts an instance directly, so there is one.
        return fLoader->EndInstance(isNamed ? &fPaths.GetOwnKeys() : nullptr);  // NOLINT(clang-analyzer-core.CallAndMessage)
    }
    TDraft draft = fDraft.Take();
    if (KeepObject(draft)) {
        return;
    }
    if (isNamed) {
        draft.hasName = true;
        draft.ownKeys = fPaths.GetOwnKeys();
    }
    fLoader->AddInstance(std::move(draft));
}

/// Without a loader, the draft is the embedded object that was asked for; returns false if there is a loader to take it.
bool TCimXmlReader::KeepObject(TDraft& draft)
{
    if (fLoader != nullptr) {
        return false;
    }
    fObject = boost::make_shared<const TEmbeddedObject>(std::move(draft.object));
    return true;
}

void TCimXmlReader::EndQualifier()
{
    TEmbeddedObject::TQualifier qualifier = fQualifier.Take();
    fItem = &fProperty.GetItem();
    if (fIsDirect) {
        // An instance has no qualifiers in the model, so there is nothing to keep.
        return fContext.Tolerate("qualifier of an instance",
                                 "qualifier " + Quote(qualifier.name) + " stands on an instance or its property; left out");
    }
    fDraft.AddQualifier(std::move(qualifier));
}

void TCimXmlReader::BeginValue()
{
    // The elements of an array belong to one value, which BeginArray has started.
    if (GetOuterState() != TTable::kArray) {
        fItem->BeginValue();
    }
}

void TCimXmlReader::EndText()
{
    if (GetState() == TTable::kArray) {
        return fItem->AddText(fText);
    }
    fItem->SetText(fText);
}

void TCimXmlReader::EndReference()
{
    TCIMValue path(fPaths.End());
    switch (GetState()) {
    case TTable::kReferenceArray:
        return fItem->AddReference(std::move(path));
    case TTable::kKeyBinding:
    case TTable::kInstanceName:
        return fPaths.AddKey(std::move(path));
    default:
        fItem->SetReference(std::move(path));
    }
}

void TCimXmlReader::FailUnexpected(const char* name) const
{
    const TOpen& open = fOpen.back();
    // Quote makes the name presentable; angle brackets take the place of its quotes.
    const std::string shown = Quote(name);
    const std::string found = "found element <" + shown.substr(1, shown.size() - 2) + ">";
    if (open.state == TTable::kStart) {
        fContext.Fail(EStatus::kParseError, found + " as the outermost element, expected <CIM>, or a part of it such as" +
                                                " <IRETURNVALUE>, <INSTANCE> or <CLASS>");
    }
    const std::string place = open.state == TTable::kEmbedded ? " as the outermost element"
                                                              : std::string(" in <") + TElement::GetName(open.element) + ">";
    fContext.Fail(EStatus::kParseError, found + place + ", expected " + TTable::DescribeExpected(open.state));
}

}  // namespace NORVZEL20
