#include <boost/smart_ptr/shared_ptr.hpp>
#include <iostream>

#include "embedded/TInMemNamespace.h"
#include "host/TNamespaceProviderManager.h"
#include "provider/TDeltaNamespace.h"

using namespace NORVZEL20;

int main()
{
    const auto provider = TNamespaceProviderManager::GetInstance()->FindProvider("delta");
    const auto delta = boost::dynamic_pointer_cast<TDeltaNamespace>(provider->AllocateNamespace(TCallContext(), false, "delta"));
    delta->AddNamespaceToCompareList(TInMemNamespace::Create("root/cimv2"));
    delta->AddNamespaceToCompareList(TInMemNamespace::Create("root/cimv2"));
    std::cout << provider->GetName(TCallContext()) << ": " << delta->NumContainers() << " containers\n";
    return 0;
}
