// Which classes are tied to a class by association classes.
//
// An association class ties the classes that its references name. A class takes part in it if one of these references, the near
// one, names the class itself or an ancestor; the classes that the other references name are the far ends. With "Location { Thing
// ref Device; Place ref Room }", Device and all its subclasses have the association class Location and the associated class Room.
// Nothing is stored for this: every look-up goes over the classes of the namespace, which are few beside their instances.

#include "embedded/store/InMemAssociations.h"

#include <algorithm>

#include "embedded/store/TInMemNamespace.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

using TClasses = std::vector<boost::shared_ptr<TInMemClass>>;

bool Admits(std::string_view wanted, std::string_view name)
{
    return wanted.empty() || TNameText::Equal(wanted, name);
}

bool AdmitsClass(std::string_view wanted, const TInMemClass& cls)
{
    return wanted.empty() || cls.IsSubclassOf(wanted);
}

/// Whether `decl` is a reference in the role wanted.
bool IsReference(const TInMemPropertyDecl& decl, std::string_view role)
{
    return decl.GetType() == TCIMValue::TCIMType::kReference && Admits(role, decl.GetName());
}

/// Whether `decl` is a reference to `cls` or an ancestor in the role wanted.
bool PointsTo(const TInMemPropertyDecl& decl, const TInMemClass& cls, std::string_view role)
{
    return IsReference(decl, role) && cls.IsSubclassOf(decl.GetReferenceClass());
}

bool HasReferenceTo(const TInMemLayout& association, const TInMemClass& cls, std::string_view role)
{
    const std::vector<std::uint32_t>& slots = association.GetOrder();
    return std::any_of(slots.begin(), slots.end(),
                       [&](std::uint32_t slot) { return PointsTo(association.GetDecl(slot), cls, role); });
}

void AddOnce(TClasses& classes, const boost::shared_ptr<TInMemClass>& cls)
{
    if (std::find(classes.begin(), classes.end(), cls) == classes.end()) {
        classes.push_back(cls);
    }
}

/// Adds the classes that the references of `association` other than `near` point to.
void AddFarEnds(const TInMemNamespace& ns, const TInMemLayout& association, std::uint32_t near, const TAssociationFilter& filter,
                TClasses& ends)
{
    for (const std::uint32_t far : association.GetOrder()) {
        if (far == near || !IsReference(association.GetDecl(far), filter.resultRole)) {
            continue;
        }
        const auto end = ns.FindClass(association.GetDecl(far).GetReferenceClass());
        if (end && AdmitsClass(filter.resultClass, *end)) {
            AddOnce(ends, end);
        }
    }
}

}  // namespace

TClasses FindAssociationClasses(const TInMemNamespace& ns, const TInMemClass& cls, const TAssociationFilter& filter)
{
    TClasses found;
    for (const auto& candidate : ns.GetClasses()) {
        if (!AdmitsClass(filter.associationClass, *candidate)) {
            continue;
        }
        const bool isTied = candidate->IsAssociation(TCallContext()) && HasReferenceTo(candidate->GetLayout(), cls, filter.role);
        if (isTied || (filter.role.empty() && cls.IsAssociatedBy(*candidate))) {
            found.push_back(candidate);
        }
    }
    return found;
}

TClasses FindAssociatedClasses(const TInMemNamespace& ns, const TInMemClass& cls, const TAssociationFilter& filter)
{
    TClasses ends;
    for (const auto& association : FindAssociationClasses(ns, cls, filter)) {
        const TInMemLayout& layout = association->GetLayout();
        for (const std::uint32_t near : layout.GetOrder()) {
            if (PointsTo(layout.GetDecl(near), cls, filter.role)) {
                AddFarEnds(ns, layout, near, filter, ends);
            }
        }
    }
    return ends;
}

}  // namespace NORVZEL20
