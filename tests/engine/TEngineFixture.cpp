#include "tests/engine/TEngineFixture.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "host/TAddToVectorCallback.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

using EType = TCIMValue::TCIMType;

TEngineFixture::TEngineFixture(EHost host, std::size_t namespaceCount) : fComparison(host)
{
    for (std::size_t index = 0; index < namespaceCount; ++index) {
        fComparison.Namespace(index).Class(
            "Disk", "",
            {TNamespaceBuilder::Key("Bus", EType::kUint32), TNamespaceBuilder::Key("Id"),
             TNamespaceBuilder::Property("Size", EType::kUint32), TNamespaceBuilder::Property("Owner", EType::kReference),
             TNamespaceBuilder::Property("Tags", EType::kArrayString), TNamespaceBuilder::Property("DateTimeOfCollection")});
    }
    fNamespaces = fComparison.AllWatched();
    fComparison.Prepare();
}

TEngine& TEngineFixture::Engine()
{
    if (!fEngine) {
        fEngine = std::make_unique<TEngine>(fComparison.GetDelta(), fNamespaces, "|fVMWareEnable");
    }
    return *fEngine;
}

boost::shared_ptr<TEngine::TDiffClassRules> TEngineFixture::RulesWithout(const std::string& excludedKeys)
{
    const auto rules = boost::make_shared<TEngine::TDiffClassRules>();
    rules->excludeKeys(excludedKeys);
    return rules;
}

boost::shared_ptr<ICIMInstance> TEngineFixture::Disk(std::size_t index, const TNamespaceBuilder::TValues& values)
{
    fComparison.Namespace(index).Instance("Disk", values);
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    fNamespaces[index]->GetClass("Disk", fNone)->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&instances), false, fNone);
    Watch().Forget();
    return instances.back();
}

TCIMReference TEngineFixture::PathTo(const std::string& namespaceName, unsigned int bus, const std::string& id)
{
    TCIMReference path;
    path.SetNamespaceName(namespaceName);
    path.SetClass(fComparison.Namespace(0).GetNamespace()->GetClass("Disk", fNone));
    path.AddKeyValue("Id", TCIMValue(id));
    path.AddKeyValue("Bus", TCIMValue(bus));
    return path;
}

std::string OutcomeOf(const std::function<void()>& call)
{
    try {
        call();
    } catch (const TZELException& error) {
        return "status " + std::to_string(error.GetStatusCode().GetStatus());
    }
    return "";
}

}  // namespace NORVZEL20
