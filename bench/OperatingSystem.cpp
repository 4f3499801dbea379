#include "bench/OperatingSystem.h"

#include <string>

#include "embedded/cimxml/TCimXmlPopulator.h"

namespace NORVZEL20 {

void AddOperatingSystem(const boost::shared_ptr<TInMemNamespace>& ns)
{
    static const std::string kDocument =
        "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>\n"
        "<VALUE.OBJECT><CLASS NAME=\"KALMO_OperatingSystem\"><PROPERTY NAME=\"Name\" TYPE=\"string\">"
        "<QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>"
        "<PROPERTY NAME=\"OSType\" TYPE=\"uint16\"/></CLASS></VALUE.OBJECT>\n"
        "<VALUE.OBJECT><INSTANCE CLASSNAME=\"KALMO_OperatingSystem\"><PROPERTY NAME=\"Name\" TYPE=\"string\"><VALUE>bench</VALUE>"
        "</PROPERTY><PROPERTY NAME=\"OSType\" TYPE=\"uint16\"><VALUE>36</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>\n"
        "</DECLGROUP></DECLARATION></CIM>\n";
    TCimXmlPopulator(ns).LoadFromMemory(kDocument.data(), kDocument.size(), "operating system");
}

}  // namespace NORVZEL20
