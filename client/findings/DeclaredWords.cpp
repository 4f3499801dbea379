#include "client/findings/DeclaredWords.h"

#include <string_view>

#include "host/ICIMQualifier.h"

namespace NORVZEL20 {

namespace {

boost::shared_ptr<TInMemClass> FindIn(const std::vector<TInventory>& inventories, const std::string& className)
{
    for (const TInventory& inventory : inventories) {
        if (const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(className)) {
            return cls;
        }
    }
    return nullptr;
}

// What EmbeddedInstance names; empty if it is not there.
std::string EmbeddedClassOf(const ICIMPropertyDecl& declaration)
{
    bool isFound = false;
    const boost::shared_ptr<ICIMQualifier> qualifier = declaration.GetQualifier("EmbeddedInstance", isFound, TCallContext());
    if (!isFound) {
        return std::string();
    }
    const TCIMValue& value = qualifier->GetValue(TCallContext());
    return value.IsNull() || value.GetType() != TCIMValue::TCIMType::kString ? std::string() : std::string(value.GetString());
}

}  // namespace

TValueWords DeclaredWords(const std::vector<TInventory>& inventories, const std::string& className, const std::string& property)
{
    const boost::shared_ptr<TInMemClass> cls = FindIn(inventories, className);
    const std::size_t dot = property.find('.');
    const boost::shared_ptr<TInMemPropertyDecl> declaration =
        cls ? cls->FindPropertyDecl(std::string_view(property).substr(0, dot)) : nullptr;
    if (!declaration) {
        return {};
    }
    return dot == std::string::npos ? TValueWords(*declaration)
                                    : DeclaredWords(inventories, EmbeddedClassOf(*declaration), property.substr(dot + 1));
}

}  // namespace NORVZEL20
