// Which classes are tied to a class by association classes.

#include <algorithm>

#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/value/TNameText.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

using TClasses = std::vector<boost::shared_ptr<TInMemClass>>;

bool IsRestrictedTo(std::string_view wanted, std::string_view name)
{
    return wanted.empty() || TNameText::Equal(wanted, name);
}

bool IsReference(const TInMemPropertyDecl& decl)
{
    return decl.GetType() == TCIMValue::TCIMType::kReference;
}

void Deliver(const TClasses& classes, const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback)
{
    for (const auto& cls : classes) {
        if (!callback(cls)) {
            return;
        }
    }
}

}  // namespace

/// Whether a reference of this association class, in the given role where one is given, points to `cls` or an ancestor of it.
bool TInMemClass::RefersTo(const TInMemClass& cls, std::string_view role) const
{
    return std::any_of(fOrder.begin(), fOrder.end(), [&](std::uint32_t slot) {
        const TInMemPropertyDecl& decl = *fSlots[slot];
        return IsReference(decl) && IsRestrictedTo(role, decl.GetName()) && cls.IsSubclassOf(decl.GetReferenceClass());
    });
}

TClasses TInMemClass::FindAssociationClasses(const std::string& resultClass, const std::string& role) const
{
    TClasses found;
    for (const auto& cls : RequireNamespace()->GetClasses()) {
        const bool isNamed = std::any_of(fAssociations.begin(), fAssociations.end(),
                                         [&cls](const boost::weak_ptr<TInMemClass>& weak) { return weak.lock() == cls; });
        const bool isWanted = resultClass.empty() || cls->IsSubclassOf(resultClass);
        if (isWanted && ((cls->IsAssociation() && cls->RefersTo(*this, role)) || (isNamed && role.empty()))) {
            found.push_back(cls);
        }
    }
    return found;
}

void TInMemClass::EnumerateAssociationClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                              const std::string& resultClass, const std::string& role, TCallContext)
{
    Deliver(FindAssociationClasses(resultClass, role), callback);
}

/// Adds the classes that the references of `association` point to, other than the one that points here.
void TInMemClass::AddOtherEnds(const TInMemClass& association, const std::string& role, const std::string& resultRole,
                               const std::string& resultClass, TClasses& ends) const
{
    const auto ns = RequireNamespace();
    for (const std::uint32_t here : association.fOrder) {
        const TInMemPropertyDecl& near = *association.fSlots[here];
        if (!IsReference(near) || !IsRestrictedTo(role, near.GetName()) || !IsSubclassOf(near.GetReferenceClass())) {
            continue;
        }
        for (const std::uint32_t there : association.fOrder) {
            const TInMemPropertyDecl& far = *association.fSlots[there];
            if (there == here || !IsReference(far) || !IsRestrictedTo(resultRole, far.GetName())) {
                continue;
            }
            const auto end = ns->FindClass(far.GetReferenceClass());
            const bool isWanted = end && (resultClass.empty() || end->IsSubclassOf(resultClass));
            if (isWanted && std::find(ends.begin(), ends.end(), end) == ends.end()) {
                ends.push_back(end);
            }
        }
    }
}

void TInMemClass::EnumerateAssociatedClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                             const std::string& associationClass, const std::string& resultClass,
                                             const std::string& role, const std::string& resultRole, TCallContext)
{
    TClasses ends;
    for (const auto& association : FindAssociationClasses(associationClass, role)) {
        AddOtherEnds(*association, role, resultRole, resultClass, ends);
    }
    Deliver(ends, callback);
}

bool TInMemClass::AddAssociationClass(boost::shared_ptr<ICIMClass> cls)
{
    const auto association = boost::dynamic_pointer_cast<TInMemClass>(cls);
    if (!association || association->fNamespace.lock() != RequireNamespace()) {
        throw TZELException(TZELStatusCode::kInvalidParameter);
    }
    for (const auto& weak : fAssociations) {
        if (weak.lock() == association) {
            return false;
        }
    }
    fAssociations.push_back(association);
    return true;
}

bool TInMemClass::RemoveAssociationClass(boost::shared_ptr<ICIMClass> cls)
{
    const auto at = std::find_if(fAssociations.begin(), fAssociations.end(),
                                 [&cls](const boost::weak_ptr<TInMemClass>& weak) { return weak.lock() == cls; });
    if (at == fAssociations.end()) {
        return false;
    }
    fAssociations.erase(at);
    return true;
}

}  // namespace NORVZEL20
