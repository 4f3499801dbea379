#include "client/rules/MadeRules.h"

#include "client/inventory/CollectObjects.h"
#include "client/inventory/UncomparedSystems.h"
#include "client/rules/RulesXml.h"
#include "host/RootClassName.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

std::string Element(const std::string& className, const char* treatment)
{
    return WriteRulesElement({className, treatment, {}, {}, {}});
}

}  // namespace

std::string MakeRulesForEverything(const std::vector<TInventory>& inventories, const std::vector<TSchemaNote>& notes)
{
    const TInventory& reference = inventories.front();
    std::string rules;
    for (const boost::shared_ptr<ICIMClass>& cls : SubclassesOf(*reference.ns->GetClass(kRootClassName, TCallContext()))) {
        rules += Element(cls->GetName(TCallContext()), "include");
    }
    if (IsNoSystemCompared(notes, inventories.size())) {
        const boost::shared_ptr<TInMemClass> made = reference.ns->FindClass(kOperatingSystemClass);
        // The class already has rules: from the loop above, or from the element of a class above it. This element replaces them.
        rules += Element(made->GetName(), "exclude");
        for (const boost::shared_ptr<ICIMClass>& cls : SubclassesOf(*made)) {
            rules += Element(cls->GetName(TCallContext()), "include");
        }
    }
    return kRulesDeclaration + WriteRulesDocument(rules);
}

}  // namespace NORVZEL20
