#include "embedded/cimxml/TCimXmlLoader.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/cimxml/MessageText.h"
#include "embedded/cimxml/TCimXmlClassMaker.h"
#include "embedded/cimxml/TCimXmlObjects.h"
#include "embedded/store/TReferenceAdapter.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

using EStatus = TZELStatusCode::EStatusCode;

/// Whether text in the property is an embedded object: what its qualifiers say, for documents that do not mark the value.
bool HoldsObjects(const TInMemPropertyDecl& decl)
{
    if (decl.GetType().GetElementType() != TCIMValue::TCIMType::kString) {
        return false;
    }
    return decl.GetQualifiers().IsTrue("EmbeddedObject") || decl.GetQualifiers().Find("EmbeddedInstance");
}

}  // namespace

TCimXmlLoader::TCimXmlLoader(TCimXmlContext& context, boost::shared_ptr<TInMemNamespace> ns)
    : fContext(context), fNamespace(ns), fStaging(std::move(ns))
{}

void TCimXmlLoader::AddQualifierDecl(const TCimXmlQualifierDraft& draft)
{
    const boost::shared_ptr<TInMemQualifierDecl> known = fNamespace->FindQualifierDecl(draft.name);
    if (!known) {
        fStaging.AddQualifierDecl(boost::make_shared<TInMemQualifierDecl>(draft.name, draft.value, draft.scope, draft.flavor));
        ++fContext.GetReport().qualifierDecls;
        return;
    }
    if (known->GetValue().GetType() != draft.value.GetType() || known->GetValue() != draft.value) {
        fContext.Fail(EStatus::kAlreadyExists, "found a second declaration of qualifier " + Quote(draft.name) +
                                                   " that differs from the first in type or value; remove one");
    }
    fContext.Tolerate("repeated qualifier", "qualifier " + Quote(draft.name) + " is declared again; the first declaration stands");
}

void TCimXmlLoader::AddClass(TCimXmlDraft draft)
{
    const std::string& name = draft.object.GetClassName();
    const auto repeated = fClassNumbers.find(name);
    if (repeated != fClassNumbers.end()) {
        if (fClasses[repeated->second].draft.object != draft.object) {
            fContext.Fail(EStatus::kAlreadyExists,
                          "found a second, different declaration of class " + Quote(name) + "; remove one");
        }
        return fContext.Tolerate("repeated class", "class " + Quote(name) + " is declared again; the first declaration stands");
    }
    if (const boost::shared_ptr<TInMemClass> known = fNamespace->FindClass(name)) {
        if (TCimXmlObjects::FromClass(*known) != TCimXmlObjects::WithoutInherited(draft.object)) {
            fContext.Fail(EStatus::kAlreadyExists,
                          "found class " + Quote(name) + ", which the namespace declares differently; load into an empty one");
        }
        return fContext.Tolerate("known class", "class " + Quote(name) + " is in the namespace already, declared the same");
    }
    fClassNumbers.emplace(name, fClasses.size());
    fClasses.push_back({std::move(draft), TClassDraft::kNew});
    ++fContext.GetReport().classes;
}

/// Declares the classes that are new; those that are stuck wait until they are needed or the document ends.
void TCimXmlLoader::DeclareClasses()
{
    for (; fFirstNew < fClasses.size(); ++fFirstNew) {
        DeclareClass(fFirstNew);
    }
}

/// Tries again to declare a class whose superclass may have come meanwhile.
void TCimXmlLoader::DeclareStuck(const char* className)
{
    const auto known = fClassNumbers.find(className);
    if (known == fClassNumbers.end()) {
        return;
    }
    for (std::size_t next = known->second; fClasses[next].state == TClassDraft::kStuck;) {
        fClasses[next].state = TClassDraft::kNew;
        const auto super = fClassNumbers.find(fClasses[next].draft.object.GetSuperClassName());
        if (super != fClassNumbers.end()) {
            next = super->second;
        }
    }
    DeclareClass(known->second);
}

/// The class and those of its superclasses that are new, upwards; `super` is what is declared above them.
std::vector<std::size_t> TCimXmlLoader::CollectChain(std::size_t number, boost::shared_ptr<TInMemClass>& super)
{
    std::vector<std::size_t> chain;
    for (std::size_t next = number; fClasses[next].state == TClassDraft::kNew;) {
        ++fTried;
        fClasses[next].state = TClassDraft::kVisited;
        chain.push_back(next);
        const std::string& superName = fClasses[next].draft.object.GetSuperClassName();
        super = fNamespace->FindClass(superName);
        const auto waiting = fClassNumbers.find(superName);
        if (superName.empty() || super || waiting == fClassNumbers.end()) {
            break;
        }
        next = waiting->second;
    }
    return chain;
}

/// Declares a class and, before it, those of its superclasses that wait; none of them where the topmost is not known yet.
void TCimXmlLoader::DeclareClass(std::size_t number)
{
    ++fTried;
    boost::shared_ptr<TInMemClass> super;
    for (std::vector<std::size_t> chain = CollectChain(number, super); !chain.empty(); chain.pop_back()) {
        TClassDraft& waiting = fClasses[chain.back()];
        waiting.state = TClassDraft::kStuck;
        if (!super && !waiting.draft.object.GetSuperClassName().empty()) {
            continue;
        }
        const TCimXmlContext::TAt at(fContext, waiting.draft.place);
        fContext.Guard([&] {
            super = TCimXmlClassMaker(fContext, *fNamespace).Make(waiting.draft, super);
            fStaging.AddClass(super);
        });
        waiting.state = TClassDraft::kDeclared;
        fDeclaredLate = fDeclaredLate || fNumber > 0 || fDeferring;
    }
}

TCimXmlLoader::TLayout* TCimXmlLoader::FindLayout(const char* className)
{
    if (fLayout != nullptr && fLayout->cls->GetName() == className) {
        return fLayout;
    }
    const auto known = fLayouts.find(className);
    if (known != fLayouts.end()) {
        return known->second.get();
    }
    boost::shared_ptr<TInMemClass> cls = fNamespace->FindClass(className);
    if (!cls) {
        DeclareClasses();
        DeclareStuck(className);
        cls = fNamespace->FindClass(className);
    }
    return cls ? AddLayout(className, cls) : nullptr;
}

TCimXmlLoader::TLayout* TCimXmlLoader::AddLayout(const char* className, const boost::shared_ptr<TInMemClass>& cls)
{
    fStaging.KeepStaticValues(*cls);
    auto layout = std::make_unique<TLayout>();
    layout->cls = cls;
    layout->positions.resize(cls->GetSlotCount());
    layout->given.resize(cls->GetSlotCount());
    for (std::uint32_t slot = 0; slot < cls->GetSlotCount(); ++slot) {
        layout->embedded.push_back(HoldsObjects(cls->GetSlotDecl(slot)));
    }
    const std::vector<std::uint32_t>& order = cls->GetSlotOrder();
    for (std::uint32_t position = 0; position < order.size(); ++position) {
        layout->positions[order[position]] = position;
    }
    return fLayouts.emplace(className, std::move(layout)).first->second.get();
}

bool TCimXmlLoader::BeginInstance(const char* className)
{
    TLayout* layout = fDeferring ? nullptr : FindLayout(className);
    if (layout == nullptr) {
        fDeferring = true;
        return false;
    }
    BeginInstance(*layout);
    return true;
}

void TCimXmlLoader::BeginInstance(TLayout& layout)
{
    fLayout = &layout;
    fInstance = layout.cls->AllocateInMemInstance();
    fExpected = 0;
    fMustHold = false;
    ++fNumber;
}

/// Finds the slot of a property; documents mostly tell them in the order of their declaration.
TCimXmlLoader::TTarget TCimXmlLoader::FindProperty(const char* name)
{
    const TInMemClass& cls = *fLayout->cls;
    const std::vector<std::uint32_t>& order = cls.GetSlotOrder();
    std::uint32_t slot = TInMemClass::kNoSlot;
    if (fExpected < order.size() && cls.GetSlotDecl(order[fExpected]).GetName() == name) {
        slot = order[fExpected];
    } else {
        slot = cls.FindSlot(name);
    }
    if (slot == TInMemClass::kNoSlot) {
        fContext.Fail(EStatus::kNotFound, "found property " + Quote(name) + ", but class " + Quote(cls.GetName()) +
                                              " declares none of that name; add its declaration or correct the name");
    }
    if (fLayout->given[slot] == fNumber) {
        fContext.Fail(EStatus::kParseError, "found property " + Quote(name) + " a second time in one instance");
    }
    fLayout->given[slot] = fNumber;
    fExpected = fLayout->positions[slot] + 1;
    const TInMemPropertyDecl& decl = cls.GetSlotDecl(slot);
    return {&decl.GetName(), slot, decl.GetType(), fLayout->embedded[slot]};
}

void TCimXmlLoader::SetProperty(const TTarget& target, TCIMValue&& value, bool metUnknownClass)
{
    if (value.GetType() != target.type) {
        value = Convert(target, value);
    }
    fInstance->SetSlot(target.slot, std::move(value));
    if (!metUnknownClass) {
        return;
    }
    fUnresolved.emplace_back(fInstance, target.slot);
    fMustHold = fMustHold || fLayout->cls->GetSlotDecl(target.slot).IsKey();
}

TCIMValue TCimXmlLoader::Convert(const TTarget& target, const TCIMValue& value)
{
    const TInMemPropertyDecl& decl = fLayout->cls->GetSlotDecl(target.slot);
    TCIMValue converted;
    if (!TValueText::Convert(value, target.type, converted)) {
        fContext.Fail(EStatus::kTypeMismatch, "found " + Quote(value.ToText()) + " of type " +
                                                  TValueText::DescribeType(value.GetType()) + " in property " +
                                                  Quote(decl.GetName()) + ", which class " + Quote(fLayout->cls->GetName()) +
                                                  " declares as " + TValueText::DescribeType(target.type));
    }
    fContext.Tolerate("other type", "property " + Quote(decl.GetName()) + " of class " + Quote(fLayout->cls->GetName()) +
                                        " is written as " + TValueText::DescribeType(value.GetType()) + "; taken as the declared " +
                                        TValueText::DescribeType(target.type));
    return converted;
}

void TCimXmlLoader::EndInstance(const TOwnKeys* ownKeys)
{
    if (ownKeys != nullptr && fInstance->FindMissingKey() != nullptr) {
        FillKeys(*ownKeys);
    }
    fLayout->isHeld = !fEnded && (fLayout->isHeld || fMustHold);
    if (fLayout->isHeld) {
        fHeld.push_back({fInstance, fContext.GetPlace()});
    } else {
        Add(fInstance);
    }
    ++fContext.GetReport().instances;
    if (fKeep) {
        fKeptInstances.push_back(fInstance);
    }
    fInstance.reset();
}

void TCimXmlLoader::Add(const boost::shared_ptr<TInMemInstance>& instance)
{
    try {
        fStaging.AddInstance(instance);
    } catch (const TZELException& error) {
        Explain(error, *instance);
    }
}

/// Takes keys that an instance leaves out from the name in front of it.
void TCimXmlLoader::FillKeys(const TOwnKeys& keys)
{
    for (const auto& [name, value] : keys) {
        const std::uint32_t slot = fLayout->cls->FindSlot(name);
        if (slot == TInMemClass::kNoSlot || fLayout->given[slot] == fNumber) {
            continue;
        }
        const TInMemPropertyDecl& decl = fLayout->cls->GetSlotDecl(slot);
        TCIMValue converted = value;
        TValueText::Convert(value, decl.GetType(), converted);  // where it cannot be, setting it says so
        TReferenceAdapter(*fNamespace).Adapt(converted);        // the name was read before classes in front of it were declared
        const bool isReference = decl.GetType() == TCIMValue::TCIMType::kReference;  // perhaps to a class that is not known yet
        SetProperty({&decl.GetName(), slot, decl.GetType(), false}, std::move(converted), isReference);
        fContext.Tolerate("key from name", "an instance of class " + Quote(fLayout->cls->GetName()) + " leaves out its key " +
                                               Quote(name) + "; taken from the name in front of it");
    }
}

void TCimXmlLoader::Explain(const TZELException& error, const TInMemInstance& instance) const
{
    const EStatus status = error.GetStatusCode().GetStatus();
    const std::string ofClass = " of class " + Quote(instance.GetInMemClass()->GetName());
    if (status == EStatus::kAlreadyExists) {
        constexpr std::size_t kLongestPath = 200;
        const std::string path = instance.GetReference().GetPath();
        fContext.Fail(status, "found a second instance " + (path.size() > kLongestPath ? Quote(path) : path) + "; instances" +
                                  ofClass + " must differ in their keys");
    }
    if (status == EStatus::kKeyMissing) {
        fContext.Fail(status, "found an instance" + ofClass + " without a value for its key " + Quote(*instance.FindMissingKey()) +
                                  "; every key needs one");
    }
    fContext.Fail(status, "found an instance" + ofClass + " that cannot be added: " + error.what());
}

void TCimXmlLoader::AddInstance(TCimXmlDraft draft)
{
    fWaiting.push_back(std::move(draft));
}

void TCimXmlLoader::AddHeld()
{
    for (const THeld& held : std::exchange(fHeld, {})) {
        const TCimXmlContext::TAt at(fContext, held.place);
        Add(held.instance);
    }
}

void TCimXmlLoader::AddWaiting(const TCimXmlDraft& draft, const TReadObjects& readObjects)
{
    const TCimXmlContext::TAt at(fContext, draft.place);
    const TEmbeddedObject& object = draft.object;
    TLayout* layout = FindLayout(object.GetClassName().c_str());
    if (layout == nullptr) {
        fContext.Fail(EStatus::kNotFound, "found an instance of class " + Quote(object.GetClassName()) +
                                              ", which is not declared; add its <CLASS> to the document or load it before");
    }
    BeginInstance(*layout);
    const TReferenceAdapter adapter(*fNamespace);
    for (std::size_t index = 0; index < object.GetProperties().size(); ++index) {
        const TCimXmlContext::TAt atProperty(fContext, draft.propertyPlaces[index]);
        const TEmbeddedObject::TProperty& property = object.GetProperties()[index];
        const TTarget target = FindProperty(property.fName.c_str());
        TCIMValue value = target.isEmbedded ? readObjects(property.fValue) : property.fValue;
        adapter.Adapt(value);
        SetProperty(target, std::move(value), false);
    }
    EndInstance(&draft.ownKeys);
}

void TCimXmlLoader::Finish(const TReadObjects& readObjects)
{
    fEnded = true;
    for (TClassDraft& cls : fClasses) {
        if (cls.state == TClassDraft::kStuck) {
            cls.state = TClassDraft::kNew;
        }
    }
    fFirstNew = 0;
    DeclareClasses();
    for (const TClassDraft& cls : fClasses) {
        if (cls.state != TClassDraft::kDeclared) {
            RefuseClass(cls.draft);
        }
    }
    if (fDeclaredLate) {
        ResolveReferences();
    }
    AddHeld();
    for (const TCimXmlDraft& draft : std::exchange(fWaiting, {})) {
        AddWaiting(draft, readObjects);
    }
}

void TCimXmlLoader::RefuseClass(const TCimXmlDraft& draft) const
{
    const TCimXmlContext::TAt at(fContext, draft.place);
    const std::string found =
        "found class " + Quote(draft.object.GetClassName()) + " with the superclass " + Quote(draft.object.GetSuperClassName());
    if (fClassNumbers.count(draft.object.GetSuperClassName()) > 0) {
        fContext.Fail(EStatus::kNotFound, found + ", which in the end is below it or below an undeclared class");
    }
    fContext.Fail(EStatus::kNotFound, found + ", which is not declared; add its <CLASS> to the document or load it before");
}

/// Writes references as their classes say that were declared only after them.
void TCimXmlLoader::ResolveReferences()
{
    const TReferenceAdapter adapter(*fNamespace);
    for (const auto& [instance, slot] : std::exchange(fUnresolved, {})) {
        TCIMValue value = instance->GetSlotValue(slot);
        if (adapter.Adapt(value)) {
            instance->SetSlot(slot, std::move(value));
        }
    }
}

std::vector<boost::shared_ptr<ICIMElement>> TCimXmlLoader::TakeElements()
{
    std::vector<boost::shared_ptr<ICIMElement>> elements;
    if (!fKeep) {
        return elements;
    }
    for (const TClassDraft& cls : fClasses) {
        elements.push_back(fNamespace->FindClass(cls.draft.object.GetClassName()));
    }
    elements.insert(elements.end(), fKeptInstances.begin(), fKeptInstances.end());
    return elements;
}

}  // namespace NORVZEL20
