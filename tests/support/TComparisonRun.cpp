// Setting up a comparison. The watched objects stand between the plug-in and the host: the store is replaced after the delta
// namespace has been made, and the compared namespaces are wrapped when they join the compare list. The destructor forgets the
// wrappers of classes, which would otherwise keep their delta namespace alive.

#include "tests/support/TComparisonRun.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>

#include "host/TNamespaceProviderManager.h"
#include "host/TZELException.h"
#include "provider/TDeltaNamespaceProvider.h"
#include "tests/support/Dump.h"
#include "tests/support/TTestAccess.h"
#include "tests/support/plain/TPlainNamespace.h"
#include "tests/support/watched/TWatchedNamespace.h"

namespace NORVZEL20 {

std::ostream& operator<<(std::ostream& out, EHost host)
{
    return out << (host == EHost::kPlain ? "Plain" : "Inmem");
}

boost::shared_ptr<ICIMNamespace> MakeNamespace(EHost host, const std::string& name)
{
    if (host == EHost::kPlain) {
        return TPlainNamespace::Create(name);
    }
    return TNamespaceProviderManager::GetInstance()->FindProvider("inmem")->AllocateNamespace(TCallContext(), false, name);
}

boost::shared_ptr<TDeltaNamespace> MakeDeltaNamespace(EHost host)
{
    if (host == EHost::kInmem) {
        const auto ns = TDeltaNamespaceProvider::GetInstance()->AllocateNamespace(TCallContext(), false, "root/delta");
        return boost::dynamic_pointer_cast<TDeltaNamespace>(ns);
    }
    const auto delta = boost::make_shared<TDeltaNamespace>(boost::shared_ptr<const ICIMNamespace>());
    TTestAccess::SetStore(*delta, TNamespaceBuilder(TPlainNamespace::Create("root/cimv2")).DeltaSchema().GetNamespace());
    return delta;
}

TComparisonRun::TComparisonRun(EHost host)
    : fHost(host), fWatch(boost::make_shared<TCallWatch>()), fDelta(MakeDeltaNamespace(host)), fStore(TTestAccess::Store(*fDelta))
{
    TTestAccess::SetStore(*fDelta, boost::make_shared<TWatchedNamespace>(fStore, fWatch, "store"));
}

TComparisonRun::~TComparisonRun()
{
    TTestAccess::ForgetWrappers(*fDelta);
}

TNamespaceBuilder& TComparisonRun::Namespace(std::size_t index)
{
    SetNamespaceCount(std::max(index + 1, fBuilders.size()));
    return *fBuilders[index];
}

void TComparisonRun::SetNamespaceCount(std::size_t count)
{
    while (fBuilders.size() < count) {
        fBuilders.push_back(std::make_unique<TNamespaceBuilder>(MakeNamespace(fHost, "root/cimv2")));
        if (fWithOperatingSystem) {
            fBuilders.back()->OperatingSystem();
        }
    }
}

void TComparisonRun::Rules(const std::string& xml)
{
    fRules = std::make_unique<TScratchFile>(xml);
    fDelta->SetSpecFileName(fRules->GetPath());
}

const std::string& TComparisonRun::GetRulesPath() const
{
    return fRules->GetPath();
}

void TComparisonRun::Prepare()
{
    if (!fPrepared) {
        for (const auto& ns : AllWatched()) {
            fDelta->AddNamespaceToCompareList(ns);
        }
        fPrepared = true;
    }
}

std::string TComparisonRun::Run()
{
    Prepare();
    try {
        fDelta->FindDifferences();
    } catch (const TZELException& error) {
        return "status " + std::to_string(error.GetStatusCode().GetStatus()) + "\n";
    }
    return "";
}

std::string TComparisonRun::Records() const
{
    return DumpRecords(fStore);
}

std::string TComparisonRun::RecordsAfterRun()
{
    const std::string status = Run();
    return Records() + status;
}

boost::shared_ptr<ICIMNamespace> TComparisonRun::Watched(std::size_t index)
{
    return boost::make_shared<TWatchedNamespace>(Namespace(index).GetNamespace(), fWatch, "ns" + std::to_string(index));
}

std::vector<boost::shared_ptr<ICIMNamespace>> TComparisonRun::AllWatched()
{
    std::vector<boost::shared_ptr<ICIMNamespace>> all;
    for (std::size_t index = 0; index < fBuilders.size(); ++index) {
        all.push_back(Watched(index));
    }
    return all;
}

}  // namespace NORVZEL20
