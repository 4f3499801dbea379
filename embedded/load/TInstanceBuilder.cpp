// Filling instances: what most of a load's time goes into.
//
// An instance is one block of memory with a slot for each property of its class. Documents mostly list properties in the order in
// which the class declares them, and instances of one class in a row. So the builder expects the class of the instance before and
// the property after the one before; both are compared before anything is looked up by name. Which properties an instance has had
// is kept in the class's layout, as the number of the last instance that had it, so nothing is cleared between instances.
#include "embedded/load/TInstanceBuilder.h"

#include <algorithm>

#include "embedded/load/AsText.h"
#include "embedded/load/DropPlaces.h"
#include "embedded/load/MessageText.h"
#include "embedded/store/TReferenceAdapter.h"
#include "embedded/value/TNameText.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

using EStatus = TZELStatusCode::EStatusCode;

namespace {

constexpr std::uint32_t kFewInstances = 8;

std::string Show(const TCIMValue& value)
{
    return value.IsNull() ? "NULL" : Quote(value.ToText());
}

}  // namespace

bool TInstanceBuilder::Begin(const char* className)
{
    TLoadLayout* layout = FindLayout(className);
    if (layout == nullptr) {
        return false;
    }
    fLayout = layout;
    fInstance = layout->cls->AllocateInMemInstance();
    fExpected = layout->first;
    // Classes with few instances share a run, because each run has room to spare.
    fContext.GetTexts().FillRun(++layout->count > kFewInstances ? &layout->run : nullptr);
    ++fNumber;
    return true;
}

/// Static properties have one value for all instances, so it is saved before the first instance changes it.
TLoadLayout* TInstanceBuilder::FindLayout(const char* className)
{
    if (fLayout != nullptr && fLayout->cls->GetName() == className) {
        return fLayout;
    }
    const auto known = fLayouts.find(className);
    if (known != fLayouts.end()) {
        return known->second.get();
    }
    const boost::shared_ptr<TInMemClass> cls = fClasses.Find(className);
    if (!cls) {
        return nullptr;
    }
    fStaging.KeepStaticValues(*cls);
    return fLayouts.emplace(className, std::make_unique<TLoadLayout>(cls)).first->second.get();
}

TLoadTarget& TInstanceBuilder::FindProperty(const char* name)
{
    TLoadTarget* target = fExpected;
    if (target == nullptr || *target->name != name) {
        const std::uint32_t slot = fLayout->cls->GetLayout().FindSlot(name);
        if (slot == TInMemLayout::kNoSlot) {
            fContext.Fail(EStatus::kNotFound, "found property " + Quote(name) + ", but class " + Quote(fLayout->cls->GetName()) +
                                                  " declares no such property; add its declaration or correct the name");
        }
        target = &fLayout->targets[slot];
    }
    if (!Take(*target)) {
        fContext.Fail(EStatus::kParseError, DescribeSecondProperty(name, "instance"));
    }
    return *target;
}

void TInstanceBuilder::SetProperty(const TLoadTarget& target, TCIMValue&& value, bool isUnsettled)
{
    if (value.GetType() != target.type) {
        TCIMValue converted;
        if (!Convert(target, value, converted)) {
            return SetBad(target, {0, AsText(value), value.ToText(), TValueText::DescribeType(target.type), fContext.GetPlace()});
        }
        value = std::move(converted);
        // A reference that was text names a class that may be declared later.
        isUnsettled = isUnsettled || target.type.GetElementType() == TCIMValue::TCIMType::kReference;
    }
    if (target.isStatic) {
        SetStatic(target, value, true);
    } else {
        fInstance->SetSlot(target.slot, std::move(value));
    }
    if (!isUnsettled) {
        return;
    }
    fLate.NoteReference(fInstance, target.slot, fClasses.CountDeclared());
    // A key that may change keeps this instance and all later ones of its class out of the namespace for now.
    fLayout->isHeld = fLayout->isHeld || fLayout->cls->GetLayout().GetDecl(target.slot).IsKey();
}

/// What is to be refused is kept as text meanwhile, so that instances with a bad key do not end the load before all is counted.
void TInstanceBuilder::SetBad(const TLoadTarget& target, const TBadValue& bad)
{
    const TInMemPropertyDecl& decl = fLayout->cls->GetLayout().GetDecl(target.slot);
    const bool isNull = fContext.GetOptions().badValues == EBadValues::kNull;
    if (isNull && decl.IsKey()) {
        fContext.FailBadKey(bad, fLayout->cls->GetName(), *target.name);
    }
    fContext.NoteBadValue(bad, fLayout->cls->GetName(), *target.name, true);
    if (decl.IsKey()) {
        fContext.GetBadValues().NoteKey();
    }
    TCIMValue text = decl.IsBag() ? bad.value.AsBag() : bad.value;
    TCIMValue value = isNull ? TCIMValue::Null(target.type) : text;
    if (target.isStatic) {
        SetStatic(target, value, isNull);
    } else {
        if (isNull) {
            fRepeats.NoteLost(*fInstance, target.slot, std::move(text));
        }
        fInstance->Change(target.slot, std::move(value));  // text does not fit the slot either
    }
}

/// The last value would be that of all instances. So if two instances give different ones, what the document says of one is lost.
/// A value that does not fit the declared type is put in without a check.
void TInstanceBuilder::SetStatic(const TLoadTarget& target, const TCIMValue& value, bool fits)
{
    TInMemPropertyDecl& decl = *fLayout->cls->GetLayout().GetSharedDecl(target.slot);
    TInMemStaticProperty& property = decl.GetStaticProperty();
    const TCIMValue before = property.GetValue();
    if (fits) {
        property.SetValue(value);
    } else {
        TInMemStaticProperty::TState state = property.GetState();
        state.value = value;
        property.SetState(state);
    }
    if (!fGivenStatics.insert(&decl).second && property.GetValue() != before) {
        fContext.Fail(EStatus::kParseError, "found " + Show(value) + " in the static property " + Quote(*target.name) +
                                                " of class " + Quote(fLayout->cls->GetName()) + ", which has " + Show(before) +
                                                " in another instance; all instances share one value");
    }
}

/// Writers do not always use the declared type: another one is accepted if the declared type can hold the value exactly.
/// Returns false if it cannot.
bool TInstanceBuilder::Convert(const TLoadTarget& target, const TCIMValue& value, TCIMValue& converted)
{
    const std::string& className = fLayout->cls->GetName();
    if (!TValueText::Convert(value, target.type, converted)) {
        return false;
    }
    fContext.Tolerate("other type", "property " + Quote(*target.name) + " of class " + Quote(className) + " is written as " +
                                        TValueText::DescribeType(value.GetType()) + "; taken as the declared " +
                                        TValueText::DescribeType(target.type));
    Localize(converted);
    return true;
}

/// References get the form that their classes declare, as far as they are declared, and lose the document's own namespace. Returns
/// whether one of them is open (see TOwnPlaceSearch).
bool TInstanceBuilder::Localize(TCIMValue& value) const
{
    TReferenceAdapter(fNamespace).Adapt(value);
    return fContext.GetOwnPlace().MakeLocal(value);
}

void TInstanceBuilder::Fill(const TDraft& draft, const TReadObjects& readObjects)
{
    const TEmbeddedObject& object = draft.object;
    if (!Begin(object.GetClassName().c_str())) {
        // Keys are inferred from the names in front of instances.
        const bool canBeInferred = !fContext.GetOptions().infersClasses && !draft.ownKeys.empty();
        fContext.Fail(EStatus::kNotFound,
                      "found an instance of class " + Quote(object.GetClassName()) + fContext.DescribeUndeclared(),
                      canBeInferred ? EAdvice::kGiveOrInferDeclaration : EAdvice::kGiveDeclaration);
    }
    auto bad = draft.badValues.begin();  // in the order of the properties
    for (std::size_t index = 0; index < object.GetProperties().size(); ++index) {
        const TLoadContext::TAt at(fContext, draft.propertyPlaces[index]);
        const TEmbeddedObject::TProperty& property = object.GetProperties()[index];
        const TLoadTarget& target = FindProperty(property.name.c_str());
        if (bad != draft.badValues.end() && bad->property == index) {
            SetBad(target, *bad++);
            continue;
        }
        TCIMValue value;
        if (!ReadObjects(target, property.value, readObjects, value)) {
            SetBad(target, {index, AsText(property.value), property.value.ToText(), "class or instance", fContext.GetPlace()});
            continue;
        }
        const bool isOpen = Localize(value);
        SetProperty(target, std::move(value), isOpen);
    }
    if (draft.takesDefaults) {
        FillDefaults();
    }
}

/// Static properties have their defaults already.
void TInstanceBuilder::FillDefaults()
{
    for (TLoadTarget* target = fLayout->first; target != nullptr; target = target->next) {
        TCIMValue value = fLayout->cls->GetLayout().GetDecl(target->slot).GetDefaultValue();
        if (target->isStatic || value.IsNull() || target->given == fNumber) {
            continue;
        }
        target->given = fNumber;
        const bool isOpen = Localize(value);
        SetProperty(*target, std::move(value), isOpen);
    }
}

/// Returns false if text is no embedded object although it looks like one, and TLoadOptions::badValues let it pass.
bool TInstanceBuilder::ReadObjects(const TLoadTarget& target, const TCIMValue& written, const TReadObjects& readObjects,
                                   TCIMValue& value) const
{
    const std::size_t mark = fContext.GetBadValues().GetMark();
    try {
        value = target.isEmbedded ? readObjects(written) : written;
        return true;
    } catch (const TPopulateError& error) {
        if (!fContext.LetsPass(error)) {
            throw;
        }
        fContext.GetBadValues().TakeBack(mark);  // those of elements in front of it
        return false;
    }
}

boost::shared_ptr<TInMemInstance> TInstanceBuilder::Take(const TOwnKeys* ownKeys)
{
    if (ownKeys != nullptr) {
        UseKeys(*ownKeys);
    }
    fContext.GetTexts().FillRun(nullptr);
    return std::move(fInstance);
}

/// Compares the instance with the name in front of it, and takes keys from there that it leaves out.
void TInstanceBuilder::UseKeys(const TOwnKeys& keys)
{
    CheckKeyCount(keys);
    for (const auto& [name, value] : keys) {
        const std::uint32_t slot = FindKey(name);
        if (slot == TInMemLayout::kNoSlot || fLayout->targets[slot].isStatic) {
            continue;
        }
        const TLoadTarget& target = fLayout->targets[slot];
        if (target.given == fNumber) {
            CheckKey(target, value);
        } else if (fInstance->FindMissingKey() != nullptr) {
            FillKey(target, value);
        }
    }
}

/// A name with no keys at all says nothing of them.
void TInstanceBuilder::CheckKeyCount(const TOwnKeys& keys) const
{
    const TInMemLayout& layout = fLayout->cls->GetLayout();
    if (keys.empty() || keys.size() >= layout.GetKeys().size()) {
        return;
    }
    for (const std::uint32_t slot : layout.GetKeys()) {
        const std::string& key = layout.GetDecl(slot).GetName();
        if (std::none_of(keys.begin(), keys.end(), [&key](const auto& given) { return TNameText::Equal(given.first, key); })) {
            fContext.Fail(EStatus::kParseError, "found no value for the key " + Quote(key) +
                                                    " in the name in front of an instance of class " +
                                                    Quote(fLayout->cls->GetName()) + "; give it there too, or leave the name out");
        }
    }
}

/// The slot of a key that a name gives. A class without keys may lack the qualifiers that make keys; then names may give any.
std::uint32_t TInstanceBuilder::FindKey(const std::string& name) const
{
    const TInMemLayout& layout = fLayout->cls->GetLayout();
    const std::vector<std::uint32_t>& keys = layout.GetKeys();
    const std::uint32_t slot = name.empty() && keys.size() == 1 ? keys.front() : layout.FindSlot(name);
    const bool isKey = slot != TInMemLayout::kNoSlot && layout.GetDecl(slot).IsKey();
    if (!isKey && !keys.empty()) {
        fContext.Fail(EStatus::kParseError, "found the key " + Quote(name) + " in the name in front of an instance of class " +
                                                Quote(fLayout->cls->GetName()) +
                                                ", which has no such key; remove it there, or correct the declaration");
    }
    return slot;
}

void TInstanceBuilder::FillKey(const TLoadTarget& target, const TCIMValue& value)
{
    TCIMValue converted = value;
    // If that fails, SetProperty reports it.
    TReferenceAdapter(fNamespace).ConvertKey(fLayout->cls->GetLayout().GetDecl(target.slot), value, converted);
    Localize(converted);  // the name was read before classes in front of it were declared
    const bool mayRefer =
        TValueAccess::GetForm(converted) == TValueAccess::kPath || TValueAccess::GetForm(converted) == TValueAccess::kObject;
    SetProperty(target, std::move(converted), mayRefer);
    fContext.Tolerate("key from name", "an instance of class " + Quote(fLayout->cls->GetName()) + " leaves out its key " +
                                           Quote(*target.name) + "; taken from the name in front of it");
}

/// References are compared without namespaces and hosts: which of them are the document's own may not be known yet.
void TInstanceBuilder::CheckKey(const TLoadTarget& target, const TCIMValue& value)
{
    TCIMValue there = fInstance->GetSlotValue(target.slot);
    if (there.IsNull() || (there.GetType() == value.GetType() && there.IsSameKey(value))) {
        return;
    }
    TCIMValue converted = value;
    TReferenceAdapter(fNamespace).ConvertKey(fLayout->cls->GetLayout().GetDecl(target.slot), value, converted);
    TReferenceAdapter(fNamespace).Adapt(converted);
    if (there.GetType() != target.type) {  // text that was kept because it does not fit; the name may write it with another type
        converted = AsText(converted);
    }
    DropPlaces(converted);
    DropPlaces(there);
    if (!there.IsSameKey(converted)) {
        fContext.Fail(EStatus::kParseError, "found " + Show(there) + " in the key " + Quote(*target.name) +
                                                " of an instance of class " + Quote(fLayout->cls->GetName()) +
                                                ", but the name in front of it says " + Show(value) + "; correct one of the two");
    }
}

}  // namespace NORVZEL20
