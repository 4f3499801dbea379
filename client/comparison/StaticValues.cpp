#include "client/comparison/StaticValues.h"

namespace NORVZEL20 {

namespace {

// Whether the property, which is static in `cls`, has another value in the other inventory or is not static there.
bool DiffersIn(const TInMemNamespace& other, const TInMemClass& cls, TInMemPropertyDecl& decl)
{
    const boost::shared_ptr<TInMemClass> counterpart = other.FindClass(cls.GetName());
    const boost::shared_ptr<TInMemPropertyDecl> there = counterpart ? counterpart->FindPropertyDecl(decl.GetName()) : nullptr;
    return there && (!there->IsStatic() || there->GetStaticProperty().GetValue() != decl.GetStaticProperty().GetValue());
}

}  // namespace

bool StaticValuesDiffer(const std::vector<TInventory>& inventories)
{
    for (const boost::shared_ptr<TInMemClass>& cls : inventories.front().ns->GetClasses()) {
        for (const std::uint32_t slot : cls->GetLayout().GetOrder()) {
            const boost::shared_ptr<TInMemPropertyDecl>& decl = cls->GetLayout().GetSharedDecl(slot);
            for (std::size_t other = 1; decl->IsStatic() && other < inventories.size(); ++other) {
                if (DiffersIn(*inventories[other].ns, *cls, *decl)) {
                    return true;
                }
            }
        }
    }
    return false;
}

}  // namespace NORVZEL20
