#include <boost/smart_ptr/shared_ptr.hpp>
#include <iostream>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/cimxml/TCimXmlWriter.h"
#include "embedded/query/TQueryError.h"
#include "embedded/services/TAssertionFailure.h"
#include "embedded/services/TCoreLog.h"
#include "embedded/store/TInMemNamespace.h"
#include "host/TNamespaceProviderManager.h"
#include "host/TOSSpecific.h"
#include "host/TZELException.h"
#include "provider/DeltaNames.h"
#include "provider/TDeltaNamespace.h"

using namespace NORVZEL20;

namespace {

class TSilentLog : public ILogger {
    void Log(int, const std::string&) override {}
};

// Whether the exceptions of both libraries arrive as what they are, here and by their bases.
bool CatchesWhatIsThrown(ICIMNamespace& delta)
{
    const auto ns = TInMemNamespace::Create("root/cimv2");
    int caught = 0;
    try {
        TCimXmlPopulator(ns).LoadFromMemory("<CIM", 4, "cut");
    } catch (const TPopulateError&) {
        ++caught;
    }
    try {
        std::string language = "WQL";
        std::string query = "no query";
        ns->ExecuteQuery([](boost::shared_ptr<ICIMInstance>) { return true; }, language, query, TCallContext());
    } catch (const TQueryError&) {
        ++caught;
    }
    try {
        delta.EnumerateRootClasses([](boost::shared_ptr<ICIMClass>) { return true; }, TCallContext());
    } catch (const TZELException&) {
        ++caught;
    }
    TSilentLog silent;
    TCoreLog::Set(&silent);
    try {
        delta.GetClass("None", {{kNamespaceIndexEntry, TCIMValue("text")}});
    } catch (const TZELException&) {
        ++caught;
    }
    try {
        boost::shared_ptr<ICIMNamespace>()->ClearInstances();
    } catch (const TAssertionFailure&) {
        ++caught;
    }
    TCoreLog::Set(nullptr);
    return caught == 5;
}

bool WritesXml()
{
    std::string text;
    TCimXmlWriter([&text](std::string_view piece) { text += piece; }).WriteNamespace(*TInMemNamespace::Create("root"));
    return text.find("<CIM") != std::string::npos;
}

}  // namespace

int main()
{
    const auto provider = TNamespaceProviderManager::GetInstance()->FindProvider(kDeltaProviderName);
    const std::string place = ", data in " + TOSSpecific::GetZELRootPath() + "\n";
    try {
        const auto delta =
            boost::dynamic_pointer_cast<TDeltaNamespace>(provider->AllocateNamespace(TCallContext(), false, "delta"));
        delta->AddNamespaceToCompareList(TInMemNamespace::Create("root/cimv2"));
        delta->AddNamespaceToCompareList(TInMemNamespace::Create("root/cimv2"));
        std::cout << provider->GetName(TCallContext()) << ": " << delta->NumContainers() << " containers" << place;
        return CatchesWhatIsThrown(*delta) && WritesXml() ? 0 : 2;
    } catch (const TZELException&) {
        std::cout << "no delta namespace" << place;
        return 1;
    }
}
