// Equality of embedded objects by structure.
//
// Properties, qualifiers and methods have no order, so both sides are sorted by name and then compared pair by pair. Parameters
// are compared in the order in which they are declared. In an instance, a null property says no more than a missing one, so nulls
// are left out there; in a class they are declarations and count.
//
// The hash must not depend on the order either: it is a sum over the properties. An array may be a bag in one object and not in
// the other, and the two may still be equal, so the elements of arrays are summed too.

#include "embedded/value/TEmbeddedObject.h"

#include <algorithm>

#include "embedded/value/TNameText.h"
#include "embedded/value/TValueXml.h"

namespace NORVZEL20 {

namespace {

// These compare parts of an object by name and contents.
bool Equal(const TEmbeddedObject::TQualifier& a, const TEmbeddedObject::TQualifier& b);
bool Equal(const TEmbeddedObject::TProperty& a, const TEmbeddedObject::TProperty& b);
bool Equal(const TEmbeddedObject::TMethod& a, const TEmbeddedObject::TMethod& b);

template <class T>
std::vector<const T*> SortByName(const std::vector<T>& elements)
{
    std::vector<const T*> sorted;
    sorted.reserve(elements.size());
    for (const T& element : elements) {
        sorted.push_back(&element);
    }
    std::stable_sort(sorted.begin(), sorted.end(), [](const T* a, const T* b) { return TNameText::Compare(a->name, b->name) < 0; });
    return sorted;
}

template <class T>
bool EqualSorted(const std::vector<const T*>& a, const std::vector<const T*>& b)
{
    return std::equal(a.begin(), a.end(), b.begin(), b.end(), [](const T* x, const T* y) { return Equal(*x, *y); });
}

bool Equal(const TEmbeddedObject::TQualifier& a, const TEmbeddedObject::TQualifier& b)
{
    return TNameText::Equal(a.name, b.name) && a.flavor == b.flavor && a.value.GetType() == b.value.GetType() && a.value == b.value;
}

bool Equal(const TEmbeddedObject::TProperty& a, const TEmbeddedObject::TProperty& b)
{
    return TNameText::Equal(a.name, b.name) && a.arraySize == b.arraySize && a.value.GetType() == b.value.GetType() &&
           TNameText::Equal(a.referenceClass, b.referenceClass) && a.value == b.value &&
           EqualSorted(SortByName(a.qualifiers), SortByName(b.qualifiers));
}

bool Equal(const TEmbeddedObject::TParameter& a, const TEmbeddedObject::TParameter& b)
{
    return TNameText::Equal(a.name, b.name) && a.arraySize == b.arraySize && a.type == b.type &&
           TNameText::Equal(a.referenceClass, b.referenceClass) && EqualSorted(SortByName(a.qualifiers), SortByName(b.qualifiers));
}

bool Equal(const TEmbeddedObject::TMethod& a, const TEmbeddedObject::TMethod& b)
{
    return TNameText::Equal(a.name, b.name) && a.type == b.type &&
           std::equal(a.parameters.begin(), a.parameters.end(), b.parameters.begin(), b.parameters.end(),
                      [](const auto& x, const auto& y) { return Equal(x, y); }) &&
           EqualSorted(SortByName(a.qualifiers), SortByName(b.qualifiers));
}

/// The same for arrays with the same elements in any order.
std::size_t HashWithoutOrder(const TCIMValue& value)
{
    if (value.IsNull() || !value.GetType().IsArray()) {
        return value.Hash();
    }
    std::size_t hash = value.GetElements().size();
    for (const TCIMValue& element : value.GetElements()) {
        hash += (element.Hash() ^ 0x9E3779B9u) * 0x9E3779B97F4A7C15u;
    }
    return hash;
}

/// The properties that count, sorted by name.
std::vector<const TEmbeddedObject::TProperty*> GetComparedProperties(const TEmbeddedObject& object)
{
    auto properties = SortByName(object.GetProperties());
    if (!object.IsClass()) {
        const auto isNull = [](const TEmbeddedObject::TProperty* property) { return property->value.IsNull(); };
        properties.erase(std::remove_if(properties.begin(), properties.end(), isNull), properties.end());
    }
    return properties;
}

}  // namespace

TEmbeddedObject::TEmbeddedObject(std::string className, bool isClass) : fClassName(std::move(className)), fIsClass(isClass) {}

const TEmbeddedObject::TProperty* TEmbeddedObject::FindProperty(std::string_view name) const noexcept
{
    const auto found = std::find_if(fProperties.begin(), fProperties.end(),
                                    [name](const TProperty& property) { return TNameText::Equal(property.name, name); });
    return found != fProperties.end() ? &*found : nullptr;
}

void TEmbeddedObject::SetSuperClassName(std::string name)
{
    fSuperClassName = std::move(name);
}

void TEmbeddedObject::AddQualifier(TQualifier qualifier)
{
    fQualifiers.push_back(std::move(qualifier));
}

void TEmbeddedObject::AddProperty(TProperty property)
{
    fProperties.push_back(std::move(property));
}

void TEmbeddedObject::AddMethod(TMethod method)
{
    fMethods.push_back(std::move(method));
}

bool TEmbeddedObject::operator==(const TEmbeddedObject& other) const
{
    return fIsClass == other.fIsClass && TNameText::Equal(fClassName, other.fClassName) &&
           TNameText::Equal(fSuperClassName, other.fSuperClassName) &&
           EqualSorted(GetComparedProperties(*this), GetComparedProperties(other)) &&
           EqualSorted(SortByName(fQualifiers), SortByName(other.fQualifiers)) &&
           EqualSorted(SortByName(fMethods), SortByName(other.fMethods));
}

std::size_t TEmbeddedObject::Hash() const
{
    std::size_t hash = TNameText::Hash(fClassName) + (fIsClass ? 1u : 0u);
    for (const TProperty& property : fProperties) {
        hash += property.value.IsNull() ? 0 : TNameText::Hash(property.name);
        hash += HashWithoutOrder(property.value) * 31;
    }
    return hash;
}

std::string TEmbeddedObject::ToText() const
{
    std::string text;
    TValueXml::AppendObject(text, *this);
    return text;
}

}  // namespace NORVZEL20
