// A property's declaration and what its qualifiers make of it.
//
// A declaration that overrides one of an ancestor inherits its qualifiers. Key and Static hold for all who override the property,
// even if their flavor forbids inheritance: instances of a subclass must have the keys of the superclass, and a static value is one
// for all. The marks (key, static, generated, bag) are asked for with every value that is set, so they are worked out when a
// qualifier or the overridden declaration changes, not when they are read. A qualifier that takes a key away is refused while the
// class has instances, because two of them could then have equal keys.

#include "embedded/store/TInMemPropertyDecl.h"

#include <algorithm>
#include <utility>
#include <vector>

#include "embedded/store/InMemClassChecks.h"
#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemInstance.h"
#include "embedded/store/TStoreRefusal.h"
#include "embedded/value/ChangeReferences.h"
#include "embedded/value/TNameText.h"
#include "host/TCIMReference.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

/// Puts stubs in the place of the classes that a reference holds: its own, and those of the references in its keys.
bool RemoveClasses(TCIMValue& value)
{
    TCIMReference path = value;
    std::vector<std::pair<std::string, TCIMValue>> changedKeys;
    path.EnumerateKeyBindings([&changedKeys](std::pair<std::string, TCIMValue> key) {
        if (ChangeReferences(key.second, &RemoveClasses)) {
            changedKeys.push_back(std::move(key));
        }
        return true;
    });
    for (const auto& [name, key] : changedKeys) {
        path.AddKeyValue(name, key);
    }
    path.SetClassName(std::string(path.GetClassName()));
    value = TCIMValue(path);
    return true;
}

}  // namespace

TInMemPropertyDecl::TInMemPropertyDecl(const std::string& name, const TCIMValue& value)
    : fName(name), fDefault(WithoutClasses(value)), fStaticProperty(*this)
{
    if (value.GetType() == TCIMValue::TCIMType::kReference && !value.IsNull()) {
        const TCIMReference path = value;
        fReferenceClass = path.GetClassName();
        // Without keys the reference only names the class.
        if (path.GetKeyCount() == 0) {
            fDefault = TCIMValue::Null(value.GetType());
        }
    }
    fStaticProperty.SetState({fDefault, TCIMValue()});
    UpdateMarks();
}

const std::string& TInMemPropertyDecl::GetName(TCallContext) const
{
    return fName;
}

TCIMValue::TCIMType TInMemPropertyDecl::GetType(TCallContext) const
{
    return GetType();
}

const TCIMValue& TInMemPropertyDecl::GetDefaultValue(TCallContext) const
{
    return fDefault;
}

bool TInMemPropertyDecl::HoldsObjects() const
{
    if (GetType().GetElementType() != TCIMValue::TCIMType::kString) {
        return false;
    }
    return GetQualifiers().IsTrue("EmbeddedObject") || GetQualifiers().Find("EmbeddedInstance");
}

void TInMemPropertyDecl::RefuseType(TCIMValue::TCIMType type, const TInMemInstance* holder) const
{
    throw TStoreRefusal(TZELStatusCode::kTypeMismatch, [&] {
        const auto owner = GetOwner();
        std::string of;
        if (holder != nullptr) {
            of = " of instance " + TStoreRefusal::Shown(holder->GetReference());
        } else if (owner) {
            of = " of class " + owner->GetName();
        }
        return "property " + fName + of + TStoreRefusal::OfOtherType(GetType(), type);
    });
}

TCIMValue TInMemPropertyDecl::Fit(TCIMValue value, const TInMemInstance* holder) const
{
    if (value.IsNull()) {
        return TCIMValue::Null(GetType());
    }
    if (value.GetType() != GetType()) {
        RefuseType(value.GetType(), holder);
    }
    if (fBag) {
        return value.AsBag();
    }
    return value;
}

TCIMValue TInMemPropertyDecl::WithoutClasses(TCIMValue value)
{
    ChangeReferences(value, &RemoveClasses);
    return value;
}

void TInMemPropertyDecl::RewriteDefault(const TCIMValue& value)
{
    const bool isStillDefault = fStaticProperty.GetValue() == fDefault;
    fDefault = WithoutClasses(value);
    if (isStillDefault) {
        fStaticProperty.SetState({fDefault, TCIMValue()});
        MarkStaticValue();
    }
}

void TInMemPropertyDecl::SetSpelling(const std::string& name)
{
    if (!TNameText::Equal(name, fName)) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    // In place: pointers to the name stay valid (ICIMClass::EnumerateKeyNames).
    std::copy(name.begin(), name.end(), fName.begin());
}

void TInMemPropertyDecl::PutQualifier(boost::shared_ptr<ICIMQualifier> qualifier)
{
    const auto put = [&] {
        TInMemNamedElement<ICIMPropertyDecl>::PutQualifier(std::move(qualifier));
        UpdateMarks();
    };
    const auto owner = GetOwner();
    // The declaration is not in a class yet, so no layout depends on the marks.
    if (!owner) {
        put();
        return;
    }
    if (TInMemQualifierSet::IsNamed(*qualifier, "Key") && !TInMemQualifierSet::HoldsTrue(*qualifier)) {
        CheckKeyStays(*owner, *this);
    }
    owner->ChangeProperty(*this, put);
}

bool TInMemPropertyDecl::IsKeyWithout(const TInMemPropertyDecl& other) const
{
    for (const TInMemPropertyDecl* decl = this; decl; decl = decl->fOverridden.get()) {
        if (decl != &other && decl->GetQualifiers().IsOwnTrue("Key")) {
            return true;
        }
    }
    return false;
}

void TInMemPropertyDecl::UpdateMarks()
{
    const TInMemQualifierSet& qualifiers = GetQualifiers();
    fKey = qualifiers.IsTrueAnywhere("Key");
    fStatic = qualifiers.IsTrueAnywhere("Static");
    fGenerated = fKey && GetType() == TCIMValue::TCIMType::kUint64 && qualifiers.IsTrue("Generated");
    fBag = GetType().IsArray() && IsBagDeclared();
    MarkStaticValue();
}

/// The static value may be the default, which stands there before the qualifiers say what kind of array it is.
void TInMemPropertyDecl::MarkStaticValue()
{
    TInMemStaticProperty::TState state = fStaticProperty.GetState();
    if (!GetType().IsArray() || state.value.IsNull() || state.value.GetType() != GetType() || state.value.IsBag() == fBag) {
        return;
    }
    const std::vector<TCIMValue>& elements = state.value.GetElements();
    state.value = fBag ? state.value.AsBag() : TCIMValue(GetType(), static_cast<unsigned int>(elements.size()), elements);
    fStaticProperty.SetState(state);
}

bool TInMemPropertyDecl::IsBagDeclared() const
{
    if (GetQualifiers().IsTrue("OctetString")) {
        return false;
    }
    // In DSP0004 an array without the qualifier is a bag.
    const auto arrayType = GetQualifiers().Find("ArrayType");
    if (!arrayType) {
        return true;
    }
    const TCIMValue& value = arrayType->GetValue(TCallContext());
    return value.IsNull() || value.GetType() != TCIMValue::TCIMType::kString || TNameText::Equal(value.GetString(), "Bag");
}

void TInMemPropertyDecl::SetOverridden(boost::shared_ptr<TInMemPropertyDecl> overridden)
{
    fOverridden = std::move(overridden);
    InheritQualifiers(fOverridden ? &fOverridden->GetQualifiers() : nullptr);
    UpdateMarks();
}

}  // namespace NORVZEL20
