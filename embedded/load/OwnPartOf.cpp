// Inherited elements in the declaration of a subclass.
//
// Servers that are asked for a whole class, and clients that keep one, write inherited elements into the subclass and mark them
// as propagated. The mark alone does not say what they are: compilers of MOF mark every element that a superclass declares first,
// also one that the subclass overrides with a key, a default, qualifiers or a narrower reference class of its own. So what counts
// is whether the element says anything else than what is inherited.
//
// An element may say less than what is inherited: an answer without qualifiers lists none. Saying less is not saying otherwise, so
// only what the element does say is compared. An override without a default has none, as it has none without the mark: writers that
// mark elements repeat the default that is inherited.
#include "embedded/load/OwnPartOf.h"

#include <algorithm>

#include "embedded/load/TStoredObjects.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

bool HasValueOf(const TEmbeddedObject::TQualifier& qualifier, const ICIMQualifier& other)
{
    const TCIMValue& value = other.GetValue(TCallContext());
    return value.GetType() == qualifier.value.GetType() && value == qualifier.value;
}

/// Whether all the qualifiers are among those of `above`. What is marked as propagated may have another flavor: writers that mark
/// do not always know the flavor.
bool AreAbove(const std::vector<TEmbeddedObject::TQualifier>& qualifiers, const TInMemQualifierSet& above)
{
    return std::all_of(qualifiers.begin(), qualifiers.end(), [&](const TEmbeddedObject::TQualifier& qualifier) {
        const boost::shared_ptr<ICIMQualifier> found = above.Find(qualifier.name);
        return found && HasValueOf(qualifier, *found) &&
               (qualifier.propagated || found->GetFlavor(TCallContext()) == qualifier.flavor);
    });
}

bool IsAbove(const TEmbeddedObject::TParameter& parameter, const TInMemParameter& above)
{
    return TNameText::Equal(parameter.name, above.GetName()) && parameter.type == above.GetType() &&
           TNameText::Equal(parameter.referenceClass, above.GetReferenceClass()) && parameter.arraySize == above.GetArraySize() &&
           AreAbove(parameter.qualifiers, above.GetQualifiers());
}

bool AreAbove(const std::vector<TEmbeddedObject::TParameter>& parameters,
              const std::vector<boost::shared_ptr<TInMemParameter>>& above)
{
    return std::equal(parameters.begin(), parameters.end(), above.begin(), above.end(),
                      [](const auto& parameter, const auto& other) { return IsAbove(parameter, *other); });
}

/// Takes out the qualifiers that `above` has.
void DropInherited(std::vector<TEmbeddedObject::TQualifier>& qualifiers, const TInMemQualifierSet& above)
{
    const auto isInherited = [&](const TEmbeddedObject::TQualifier& qualifier) { return IsInherited(qualifier, &above); };
    qualifiers.erase(std::remove_if(qualifiers.begin(), qualifiers.end(), isInherited), qualifiers.end());
}

}  // namespace

bool IsInherited(const TEmbeddedObject::TQualifier& qualifier, const TInMemQualifierSet* above)
{
    if (above == nullptr || !qualifier.propagated) {
        return false;
    }
    const boost::shared_ptr<ICIMQualifier> found = above->Find(qualifier.name);
    return found && (found->GetFlavor(TCallContext()) & ICIMQualifierDecl::kFlavorToSubclass) != 0 && HasValueOf(qualifier, *found);
}

std::optional<TEmbeddedObject::TProperty> OwnPartOf(const TEmbeddedObject::TProperty& property, const TInMemPropertyDecl& above)
{
    const bool hasDefault = !property.value.IsNull();
    const bool hasClass = !property.referenceClass.empty();
    const bool hasSize = property.arraySize != 0;
    if ((!hasDefault || property.value == above.GetDefaultValue()) &&
        (!hasClass || TNameText::Equal(property.referenceClass, above.GetReferenceClass())) &&
        (!hasSize || property.arraySize == above.GetArraySize()) && AreAbove(property.qualifiers, above.GetQualifiers())) {
        return std::nullopt;
    }
    TEmbeddedObject::TProperty own = property;
    own.referenceClass = hasClass ? own.referenceClass : above.GetReferenceClass();
    own.arraySize = hasSize ? own.arraySize : above.GetArraySize();
    DropInherited(own.qualifiers, above.GetQualifiers());
    return own;
}

std::optional<TEmbeddedObject::TMethod> OwnPartOf(const TEmbeddedObject::TMethod& method, const TInMemMethodDecl& above)
{
    const bool saysParameters = !method.parameters.empty();
    if (method.type == above.GetType() && (!saysParameters || AreAbove(method.parameters, above.GetParameters())) &&
        AreAbove(method.qualifiers, above.GetQualifiers())) {
        return std::nullopt;
    }
    TEmbeddedObject::TMethod own = method;
    if (!saysParameters) {
        own.parameters = TStoredObjects::FromMethod(above).parameters;
    }
    DropInherited(own.qualifiers, above.GetQualifiers());
    return own;
}

}  // namespace NORVZEL20
