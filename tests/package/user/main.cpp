#include <boost/smart_ptr/shared_ptr.hpp>
#include <iostream>

#include "embedded/store/TInMemNamespace.h"
#include "host/TNamespaceProviderManager.h"
#include "host/TOSSpecific.h"
#include "host/TZELException.h"
#include "provider/TDeltaNamespace.h"

using namespace NORVZEL20;

int main()
{
    const auto provider = TNamespaceProviderManager::GetInstance()->FindProvider("delta");
    const std::string place = ", data in " + TOSSpecific::GetZELRootPath() + "\n";
    try {
        const auto delta =
            boost::dynamic_pointer_cast<TDeltaNamespace>(provider->AllocateNamespace(TCallContext(), false, "delta"));
        delta->AddNamespaceToCompareList(TInMemNamespace::Create("root/cimv2"));
        delta->AddNamespaceToCompareList(TInMemNamespace::Create("root/cimv2"));
        std::cout << provider->GetName(TCallContext()) << ": " << delta->NumContainers() << " containers" << place;
    } catch (const TZELException&) {
        std::cout << "no delta namespace" << place;
        return 1;
    }
    return 0;
}
