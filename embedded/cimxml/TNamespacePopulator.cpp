#include "host/TNamespacePopulator.h"

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "host/TRootObject.h"

namespace NORVZEL20 {

std::vector<boost::shared_ptr<ICIMElement>> TNamespacePopulator::PopulateFromXMLFile(boost::shared_ptr<ICIMNamespace> ns,
                                                                                     std::string path)
{
    TCimXmlPopulator populator(ns);
    populator.KeepElements();
    try {
        populator.LoadFile(path);
    } catch (const TPopulateError& error) {
        TRootObject::GetCoreLogger()->Log(0, error.what());
        throw;
    }
    return populator.TakeElements();
}

}  // namespace NORVZEL20
