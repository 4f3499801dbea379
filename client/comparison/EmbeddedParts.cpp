// Two embedded instances are compared as values of one property. To a person it matters which of their own properties differ:
//
//   Settings: <INSTANCE CLASSNAME="Cfg">... -> <INSTANCE CLASSNAME="Cfg">...      the property, with both values as a whole
//   Settings.Speed: 100 -> 200                                                    its part
//
// A part is a difference of the same form as the whole: the property of the reference's object, and the distinct values of the
// others' objects. If its values are embedded instances again, it has parts of its own.
//
// Objects may also differ in qualifiers or methods. Parts must not hide that, so they are kept only if the reference's object with
// the values of the other one is equal to the other one.
#include "client/comparison/EmbeddedParts.h"

#include <algorithm>
#include <set>
#include <utility>

#include "client/comparison/TValueGroups.h"
#include "client/inventory/HashValue.h"
#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

using TObject = boost::shared_ptr<const TEmbeddedObject>;

// The object if the value is an embedded instance, otherwise null.
TObject InstanceIn(const TCIMValue& value)
{
    if (value.IsNull() || value.GetType() != TCIMValue::TCIMType::kString) {
        return TObject();
    }
    const TObject object = value.GetEmbeddedObject();
    return object && !object->IsClass() ? object : TObject();
}

// The objects of the reference, if there is one, and of the groups in their order; empty if they are not all instances of one
// class.
std::vector<TObject> ObjectsOf(const TValueDifference& difference, bool hasReference)
{
    std::vector<TObject> objects;
    if (hasReference) {
        objects.push_back(InstanceIn(difference.reference));
    }
    for (const TValueDifference::TGroup& group : difference.others) {
        objects.push_back(InstanceIn(group.value));
    }
    const bool alike = std::all_of(objects.begin(), objects.end(), [&objects](const TObject& object) {
        return object && objects.front() && TNameText::Equal(object->GetClassName(), objects.front()->GetClassName());
    });
    return alike ? objects : std::vector<TObject>();
}

// The names of all properties, in ascending order, in the spelling of the first object that has them.
std::set<std::string, TNameText::TLess> NamesIn(const std::vector<TObject>& objects)
{
    std::set<std::string, TNameText::TLess> names;
    for (const TObject& object : objects) {
        for (const TEmbeddedObject::TProperty& property : object->GetProperties()) {
            names.insert(property.name);
        }
    }
    return names;
}

// The value of a property; a null of the type that it has in another object if this object lacks it.
TCIMValue ValueIn(const TEmbeddedObject& object, const std::string& name, const std::vector<TObject>& objects)
{
    if (const TEmbeddedObject::TProperty* const property = object.FindProperty(name)) {
        return property->value;
    }
    for (const TObject& other : objects) {
        if (const TEmbeddedObject::TProperty* const property = other->FindProperty(name)) {
            return TCIMValue::Null(property->value.GetType());
        }
    }
    return TCIMValue();
}

void AddToGroup(TValueDifference::TGroup& group, const TValueDifference::TGroup& holders)
{
    for (std::size_t i = 0; i < holders.inventories.size(); ++i) {
        group.Add(holders.inventories[i], holders.CountInstances(i));
    }
}

bool AreEqual(const TCIMValue& one, const TCIMValue& other)
{
    return one == other;
}

// The property as a difference of its own; it has no others if the objects agree in it.
TValueDifference PartOf(const TValueDifference& whole, const std::string& name, const std::vector<TObject>& objects,
                        bool hasReference)
{
    TValueDifference part;
    part.property = whole.property + "." + name;
    if (hasReference) {
        part.reference = ValueIn(*objects.front(), name, objects);
    }
    TValueGroups groups(part, &AreEqual, &HashValue);
    for (std::size_t i = 0; i < whole.others.size(); ++i) {
        const TCIMValue value = ValueIn(*objects[i + (hasReference ? 1 : 0)], name, objects);
        if (!hasReference || part.reference != value) {
            AddToGroup(groups.Get(value), whole.others[i]);
        }
    }
    if (!hasReference && !groups.Differ()) {
        part.others.clear();
    }
    return part;
}

// Whether `one` would equal `other` if its properties had the other's values.
bool DifferInValuesOnly(const TEmbeddedObject& one, const TEmbeddedObject& other)
{
    TEmbeddedObject changed(one.GetClassName());
    for (const TEmbeddedObject::TQualifier& qualifier : one.GetQualifiers()) {
        changed.AddQualifier(qualifier);
    }
    for (TEmbeddedObject::TProperty property : one.GetProperties()) {
        const TEmbeddedObject::TProperty* const there = other.FindProperty(property.name);
        property.value = there == nullptr ? TCIMValue::Null(property.value.GetType()) : there->value;
        changed.AddProperty(property);
    }
    for (const TEmbeddedObject::TProperty& property : other.GetProperties()) {
        if (one.FindProperty(property.name) == nullptr) {
            changed.AddProperty(property);
        }
    }
    return changed == other;
}

}  // namespace

void AddEmbeddedParts(TValueDifference& difference, bool hasReference)
{
    const std::vector<TObject> objects = ObjectsOf(difference, hasReference);
    if (objects.empty() || !std::all_of(objects.begin() + 1, objects.end(), [&objects](const TObject& object) {
            return DifferInValuesOnly(*objects.front(), *object);
        })) {
        return;
    }
    for (const std::string& name : NamesIn(objects)) {
        TValueDifference part = PartOf(difference, name, objects, hasReference);
        if (!part.others.empty()) {
            AddEmbeddedParts(part, hasReference);
            difference.parts.push_back(std::move(part));
        }
    }
}

}  // namespace NORVZEL20
