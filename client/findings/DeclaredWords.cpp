#include "client/findings/DeclaredWords.h"

#include <string_view>

#include "client/text/TextOfQualifier.h"

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
    return dot == std::string::npos
               ? TValueWords(*declaration)
               : DeclaredWords(inventories, TextOfQualifier(*declaration, "EmbeddedInstance"), property.substr(dot + 1));
}

}  // namespace NORVZEL20
