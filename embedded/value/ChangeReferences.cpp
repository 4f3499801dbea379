#include "embedded/value/ChangeReferences.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <utility>
#include <vector>

#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TValueAccess.h"

namespace NORVZEL20 {

namespace {

using TAccess = TValueAccess;
using TChange = boost::function<bool(TCIMValue&)>;

bool MayRefer(const TCIMValue& element)
{
    return TAccess::GetForm(element) == TAccess::kPath || TAccess::GetForm(element) == TAccess::kObject;
}

bool ChangeInElements(TCIMValue& value, const TChange& change)
{
    const std::vector<TCIMValue>& stored = value.GetElements();
    if (std::none_of(stored.begin(), stored.end(), MayRefer)) {
        return false;
    }
    bool isChanged = false;
    std::vector<TCIMValue> elements = stored;
    for (TCIMValue& element : elements) {
        isChanged = ChangeReferences(element, change) || isChanged;
    }
    if (isChanged) {
        const TCIMValue changed(value.GetType(), static_cast<unsigned int>(elements.size()), elements);
        value = value.IsBag() ? changed.AsBag() : changed;
    }
    return isChanged;
}

bool ChangeInObject(TCIMValue& value, const TChange& change)
{
    const boost::shared_ptr<const TEmbeddedObject> object = value.GetEmbeddedObject();
    std::vector<TEmbeddedObject::TProperty> properties = object->GetProperties();
    bool isChanged = false;
    for (TEmbeddedObject::TProperty& property : properties) {
        isChanged = ChangeReferences(property.value, change) || isChanged;
    }
    if (!isChanged) {
        return false;
    }
    const auto changed = boost::make_shared<TEmbeddedObject>(object->GetClassName(), object->IsClass());
    changed->SetSuperClassName(object->GetSuperClassName());
    for (const TEmbeddedObject::TQualifier& qualifier : object->GetQualifiers()) {
        changed->AddQualifier(qualifier);
    }
    for (TEmbeddedObject::TProperty& property : properties) {
        changed->AddProperty(std::move(property));
    }
    for (const TEmbeddedObject::TMethod& method : object->GetMethods()) {
        changed->AddMethod(method);
    }
    value = TCIMValue(boost::shared_ptr<const TEmbeddedObject>(changed));
    return true;
}

}  // namespace

bool ChangeReferences(TCIMValue& value, const TChange& change)
{
    switch (TAccess::GetForm(value)) {
    case TAccess::kPath:
        return change(value);
    case TAccess::kArray:
    case TAccess::kBag:
        return ChangeInElements(value, change);
    case TAccess::kObject:
        return ChangeInObject(value, change);
    default:
        return false;
    }
}

}  // namespace NORVZEL20
