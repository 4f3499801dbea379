// Methods are few and rarely asked for, so inherited ones are not copied into the subclass: a search goes up from set to set. Each
// own method remembers the one that it overrides. One that overrides none is the first of its name; GetAll lists them in their
// order.

#include "embedded/store/TInMemMethodSet.h"

#include <algorithm>

#include "embedded/store/FindNamed.h"

namespace NORVZEL20 {

boost::shared_ptr<TInMemMethodDecl> TInMemMethodSet::Find(std::string_view name) const
{
    boost::shared_ptr<TInMemMethodDecl> found;
    for (const TInMemMethodSet* set = this; set && !found; set = set->fParent) {
        found = FindNamed(set->fOwn, name);
    }
    return found;
}

std::vector<boost::shared_ptr<TInMemMethodDecl>> TInMemMethodSet::GetAll() const
{
    std::vector<const TInMemMethodSet*> lineage;
    for (const TInMemMethodSet* set = this; set; set = set->fParent) {
        lineage.push_back(set);
    }
    std::vector<boost::shared_ptr<TInMemMethodDecl>> methods;
    for (auto set = lineage.rbegin(); set != lineage.rend(); ++set) {
        for (const auto& method : (*set)->fOwn) {
            // A method that overrides another one is listed in the place of the first.
            if (!method->GetOverridden()) {
                methods.push_back(Find(method->GetName()));
            }
        }
    }
    return methods;
}

bool TInMemMethodSet::Add(const boost::shared_ptr<TInMemMethodDecl>& method)
{
    if (FindNamed(fOwn, method->GetName())) {
        return false;
    }
    fOwn.push_back(method);
    Inherit(method->GetName());
    return true;
}

bool TInMemMethodSet::Remove(const boost::shared_ptr<TInMemMethodDecl>& method)
{
    const auto at = std::find(fOwn.begin(), fOwn.end(), method);
    if (at == fOwn.end()) {
        return false;
    }
    fOwn.erase(at);
    return true;
}

void TInMemMethodSet::Inherit(std::string_view name)
{
    if (const auto own = FindNamed(fOwn, name)) {
        own->SetOverridden(fParent ? fParent->Find(name) : nullptr);
    }
}

void TInMemMethodSet::InheritAll()
{
    for (const auto& own : fOwn) {
        own->SetOverridden(fParent ? fParent->Find(own->GetName()) : nullptr);
    }
}

}  // namespace NORVZEL20
