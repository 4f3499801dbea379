#include "embedded/TCimXmlLoader.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/TCimXmlClassMaker.h"
#include "embedded/TCimXmlObjects.h"
#include "embedded/TValueText.h"

namespace NORVZEL20 {

namespace {

using EStatus = TZELStatusCode::EStatusCode;

std::string Quote(std::string_view text)
{
    return TCimXmlContext::Quote(text);
}

/// Whether text in the property is an embedded object: what its qualifiers say, for documents that do not mark the value.
bool HoldsObjects(const TInMemPropertyDecl& decl)
{
    if (decl.GetType().GetElementType() != TCIMValue::TCIMType::kString)
        return false;
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
    if (known->GetValue().GetType() != draft.value.GetType() || known->GetValue() != draft.value)
        fContext.Fail(EStatus::kAlreadyExists, "found a second declaration of qualifier " + Quote(draft.name) +
                                                   " that differs from the first in type or value; remove one");
    fContext.Tolerate("repeated qualifier", "qualifier " + Quote(draft.name) + " is declared again; the first declaration stands");
}

void TCimXmlLoader::AddClass(TCimXmlDraft draft)
{
    const std::string& name = draft.object.GetClassName();
    const auto repeated = fClassNumbers.find(name);
    if (repeated != fClassNumbers.end()) {
        if (fClasses[repeated->second].draft.object != draft.object)
            fContext.Fail(EStatus::kAlreadyExists,
                          "found a second, different declaration of class " + Quote(name) + "; remove one");
        return fContext.Tolerate("repeated class", "class " + Quote(name) + " is declared again; the first declaration stands");
    }
    if (const boost::shared_ptr<TInMemClass> known = fNamespace->FindClass(name)) {
        if (TCimXmlObjects::FromClass(*known) != TCimXmlObjects::WithoutInherited(draft.object))
            fContext.Fail(EStatus::kAlreadyExists,
                          "found class " + Quote(name) + ", which the namespace declares differently; load into an empty one");
        return fContext.Tolerate("known class", "class " + Quote(name) + " is in the namespace already, declared the same");
    }
    fClassNumbers.emplace(name, fClasses.size());
    fClasses.push_back({std::move(draft), TClassDraft::kWaiting});
    fNewClasses = true;
    ++fContext.GetReport().classes;
}

void TCimXmlLoader::DeclareClasses()
{
    fNewClasses = false;
    for (std::size_t number = 0; number < fClasses.size(); ++number)
        DeclareClass(number);
}

/// Declares a class and, before it, those of its superclasses that wait; none of them where the topmost is not known yet.
void TCimXmlLoader::DeclareClass(std::size_t number)
{
    std::vector<std::size_t> chain;
    boost::shared_ptr<TInMemClass> super;
    for (std::size_t next = number; fClasses[next].state == TClassDraft::kWaiting;) {
        fClasses[next].state = TClassDraft::kVisited;
        chain.push_back(next);
        const std::string& superName = fClasses[next].draft.object.GetSuperClassName();
        super = fNamespace->FindClass(superName);
        const auto waiting = fClassNumbers.find(superName);
        if (superName.empty() || super || waiting == fClassNumbers.end())
            break;
        next = waiting->second;
    }
    for (; !chain.empty(); chain.pop_back()) {
        TClassDraft& waiting = fClasses[chain.back()];
        waiting.state = TClassDraft::kWaiting;
        if (!super && !waiting.draft.object.GetSuperClassName().empty())
            continue;
        const TCimXmlContext::TAt at(fContext, waiting.draft.place);
        super = TCimXmlClassMaker(fContext, *fNamespace).Make(waiting.draft, super);
        fStaging.AddClass(super);
        waiting.state = TClassDraft::kDeclared;
        fDeclaredLate = fDeclaredLate || fNumber > 0 || fDeferring;
    }
}

TCimXmlLoader::TLayout* TCimXmlLoader::FindLayout(const char* className)
{
    if (fLayout != nullptr && fLayout->cls->GetName() == className)
        return fLayout;
    const auto known = fLayouts.find(className);
    if (known != fLayouts.end())
        return known->second.get();
    boost::shared_ptr<TInMemClass> cls = fNamespace->FindClass(className);
    if (!cls && fNewClasses) {
        DeclareClasses();
        cls = fNamespace->FindClass(className);
    }
    return cls ? AddLayout(className, cls) : nullptr;
}

TCimXmlLoader::TLayout* TCimXmlLoader::AddLayout(const char* className, const boost::shared_ptr<TInMemClass>& cls)
{
    auto layout = std::make_unique<TLayout>();
    layout->cls = cls;
    layout->positions.resize(cls->GetSlotCount());
    layout->given.resize(cls->GetSlotCount());
    for (std::uint32_t slot = 0; slot < cls->GetSlotCount(); ++slot)
        layout->embedded.push_back(HoldsObjects(cls->GetSlotDecl(slot)));
    const std::vector<std::uint32_t>& order = cls->GetSlotOrder();
    for (std::uint32_t position = 0; position < order.size(); ++position)
        layout->positions[order[position]] = position;
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
    ++fNumber;
}

/// Finds the slot of a property; documents mostly tell them in the order of their declaration.
TCimXmlLoader::TTarget TCimXmlLoader::FindProperty(const char* name)
{
    const TInMemClass& cls = *fLayout->cls;
    const std::vector<std::uint32_t>& order = cls.GetSlotOrder();
    std::uint32_t slot = TInMemClass::kNoSlot;
    if (fExpected < order.size() && cls.GetSlotDecl(order[fExpected]).GetName() == name)
        slot = order[fExpected];
    else
        slot = cls.FindSlot(name);
    if (slot == TInMemClass::kNoSlot)
        fContext.Fail(EStatus::kNotFound, "found property " + Quote(name) + ", but class " + Quote(cls.GetName()) +
                                              " declares none of that name; add its declaration or correct the name");
    if (fLayout->given[slot] == fNumber)
        fContext.Fail(EStatus::kParseError, "found property " + Quote(name) + " a second time in one instance");
    fLayout->given[slot] = fNumber;
    fExpected = fLayout->positions[slot] + 1;
    const TInMemPropertyDecl& decl = cls.GetSlotDecl(slot);
    return {&decl.GetName(), slot, decl.GetType(), fLayout->embedded[slot]};
}

void TCimXmlLoader::SetProperty(const TTarget& target, TCIMValue&& value, bool metUnknownClass)
{
    if (value.GetType() != target.type)
        value = Convert(target, value);
    fInstance->SetSlot(target.slot, std::move(value));
    if (metUnknownClass)
        fUnresolved.emplace_back(fInstance, target.slot);
}

TCIMValue TCimXmlLoader::Convert(const TTarget& target, const TCIMValue& value)
{
    const TInMemPropertyDecl& decl = fLayout->cls->GetSlotDecl(target.slot);
    const auto describe = [](TCIMValue::TCIMType type) {
        return std::string(TValueText::GetTypeName(type)) + (type.IsArray() ? "[]" : "");
    };
    TCIMValue converted;
    if (!TValueText::Convert(value, target.type, converted))
        fContext.Fail(EStatus::kTypeMismatch, "found " + Quote(value.ToText()) + " of type " + describe(value.GetType()) +
                                                  " in property " + Quote(decl.GetName()) + ", which class " +
                                                  Quote(fLayout->cls->GetName()) + " declares as " + describe(target.type));
    fContext.Tolerate("other type", "property " + Quote(decl.GetName()) + " of class " + Quote(fLayout->cls->GetName()) +
                                        " is written as " + describe(value.GetType()) + "; taken as the declared " +
                                        describe(target.type));
    return converted;
}

void TCimXmlLoader::EndInstance(const TOwnKeys* ownKeys)
{
    if (ownKeys != nullptr && fInstance->FindMissingKey() != nullptr)
        FillKeys(*ownKeys);
    try {
        fStaging.AddInstance(fInstance);
    } catch (const TZELException& error) {
        Explain(error);
    }
    ++fContext.GetReport().instances;
    if (fKeep)
        fKeptInstances.push_back(fInstance);
    fInstance.reset();
}

/// Takes keys that an instance leaves out from the name in front of it.
void TCimXmlLoader::FillKeys(const TOwnKeys& keys)
{
    for (const auto& [name, value] : keys) {
        const std::uint32_t slot = fLayout->cls->FindSlot(name);
        if (slot == TInMemClass::kNoSlot || fLayout->given[slot] == fNumber)
            continue;
        const TInMemPropertyDecl& decl = fLayout->cls->GetSlotDecl(slot);
        TCIMValue converted = value;
        TValueText::Convert(value, decl.GetType(), converted);  // where it cannot be, setting it says so
        SetProperty({&decl.GetName(), slot, decl.GetType(), false}, std::move(converted), false);
        fContext.Tolerate("key from name", "an instance of class " + Quote(fLayout->cls->GetName()) + " leaves out its key " +
                                               Quote(name) + "; taken from the name in front of it");
    }
}

void TCimXmlLoader::Explain(const TZELException& error) const
{
    const EStatus status = error.GetStatusCode().GetStatus();
    const std::string ofClass = " of class " + Quote(fLayout->cls->GetName());
    if (status == EStatus::kAlreadyExists) {
        constexpr std::size_t kLongestPath = 200;
        const std::string path = fInstance->GetReference().GetPath();
        fContext.Fail(status, "found a second instance " + (path.size() > kLongestPath ? Quote(path) : path) + "; instances" +
                                  ofClass + " must differ in their keys");
    }
    if (status == EStatus::kKeyMissing)
        fContext.Fail(status, "found an instance" + ofClass + " without a value for its key " +
                                  Quote(*fInstance->FindMissingKey()) + "; every key needs one");
    fContext.Fail(status, "found an instance" + ofClass + " that cannot be added: " + error.what());
}

void TCimXmlLoader::AddInstance(TCimXmlDraft draft)
{
    fWaiting.push_back(std::move(draft));
}

void TCimXmlLoader::AddWaiting(const TCimXmlDraft& draft)
{
    const TCimXmlContext::TAt at(fContext, draft.place);
    const TEmbeddedObject& object = draft.object;
    TLayout* layout = FindLayout(object.GetClassName().c_str());
    if (layout == nullptr)
        fContext.Fail(EStatus::kNotFound, "found an instance of class " + Quote(object.GetClassName()) +
                                              ", which is not declared; add its <CLASS> to the document or load it before");
    BeginInstance(*layout);
    for (std::size_t index = 0; index < object.GetProperties().size(); ++index) {
        const TCimXmlContext::TAt atProperty(fContext, draft.propertyPlaces[index]);
        const TEmbeddedObject::TProperty& property = object.GetProperties()[index];
        SetProperty(FindProperty(property.fName.c_str()), TCIMValue(property.fValue), true);
    }
    EndInstance(&draft.ownKeys);
}

void TCimXmlLoader::Finish()
{
    DeclareClasses();
    for (const TClassDraft& cls : fClasses)
        if (cls.state != TClassDraft::kDeclared)
            RefuseClass(cls.draft);
    for (TCimXmlDraft& draft : std::exchange(fWaiting, {}))
        AddWaiting(draft);
    if (fDeclaredLate)
        ResolveReferences();
}

void TCimXmlLoader::RefuseClass(const TCimXmlDraft& draft) const
{
    const TCimXmlContext::TAt at(fContext, draft.place);
    const std::string found =
        "found class " + Quote(draft.object.GetClassName()) + " with the superclass " + Quote(draft.object.GetSuperClassName());
    if (fClassNumbers.count(draft.object.GetSuperClassName()) > 0)
        fContext.Fail(EStatus::kNotFound, found + ", which in the end is below it or below an undeclared class");
    fContext.Fail(EStatus::kNotFound, found + ", which is not declared; add its <CLASS> to the document or load it before");
}

/// Gives references their classes that were declared only after them.
void TCimXmlLoader::ResolveReferences()
{
    const auto resolve = [&](const TCIMValue& value) {
        if (value.IsNull() || value.GetType() != TCIMValue::TCIMType::kReference)
            return value;
        TCIMReference path = value;
        if (const boost::shared_ptr<TInMemClass> cls = fNamespace->FindClass(path.GetClassName()))
            path.SetClass(cls);
        return TCIMValue(path);
    };
    for (const auto& [instance, slot] : fUnresolved) {
        const TCIMValue& value = instance->GetSlotValue(slot);
        if (value.IsNull() || value.GetType() == TCIMValue::TCIMType::kReference) {
            instance->SetSlot(slot, resolve(value));
        } else if (value.GetType() == TCIMValue::TCIMType::kArrayReference) {
            std::vector<TCIMValue> elements = value.GetElements();
            std::transform(elements.begin(), elements.end(), elements.begin(), resolve);
            instance->SetSlot(slot, TCIMValue(value.GetType(), static_cast<unsigned int>(elements.size()), elements));
        }
    }
}

std::vector<boost::shared_ptr<ICIMElement>> TCimXmlLoader::TakeElements()
{
    std::vector<boost::shared_ptr<ICIMElement>> elements;
    if (!fKeep)
        return elements;
    for (const TClassDraft& cls : fClasses)
        elements.push_back(fNamespace->FindClass(cls.draft.object.GetClassName()));
    elements.insert(elements.end(), fKeptInstances.begin(), fKeptInstances.end());
    return elements;
}

}  // namespace NORVZEL20
