#include "fuzz/SampleInventory.h"

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/cimxml/TCimXmlWriter.h"

namespace NORVZEL20 {

namespace {

std::string Property(const std::string& name, const std::string& type, const std::string& value)
{
    return "<PROPERTY NAME=\"" + name + "\" TYPE=\"" + type + "\"><VALUE>" + value + "</VALUE></PROPERTY>\n";
}

std::string Declaration(const std::string& name, const std::string& type)
{
    return "<PROPERTY NAME=\"" + name + "\" TYPE=\"" + type + "\"/>\n";
}

std::string Key(const std::string& name, const std::string& type)
{
    return "<PROPERTY NAME=\"" + name + "\" TYPE=\"" + type +
           "\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>\n";
}

std::string ReferenceKey(const std::string& name)
{
    return "<PROPERTY.REFERENCE NAME=\"" + name +
           "\" REFERENCECLASS=\"Device\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER>"
           "</PROPERTY.REFERENCE>\n";
}

std::string Object(const std::string& element, const std::string& attributes, const std::string& content)
{
    return "<VALUE.OBJECT><" + element + " " + attributes + ">\n" + content + "</" + element + "></VALUE.OBJECT>\n";
}

std::string Classes()
{
    return Object("CLASS", "NAME=\"KALMO_OperatingSystem\"", Key("Name", "string") + Declaration("OSType", "uint16")) +
           Object("CLASS", "NAME=\"Device\"",
                  Key("Id", "string") + Declaration("Size", "uint64") + Declaration("Load", "real64") +
                      Declaration("Online", "boolean")) +
           Object("CLASS", "NAME=\"Disk\" SUPERCLASS=\"Device\"",
                  Declaration("Temperature", "sint16") + Declaration("Seen", "datetime") + Declaration("Drive", "char16") +
                      Declaration("Ratio", "real32") +
                      "<PROPERTY.ARRAY NAME=\"Labels\" TYPE=\"string\"/>\n"
                      "<PROPERTY NAME=\"Settings\" TYPE=\"string\" EmbeddedObject=\"object\"/>\n") +
           Object("CLASS", "NAME=\"Port\" SUPERCLASS=\"Device\"", Key("Slot", "uint8")) +
           Object("CLASS", "NAME=\"Cable\"",
                  "<QUALIFIER NAME=\"Association\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER>\n" + ReferenceKey("From") +
                      ReferenceKey("To"));
}

std::string ReferenceTo(const std::string& name, const std::string& id)
{
    return "<PROPERTY.REFERENCE NAME=\"" + name + "\"><VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"Disk\"><KEYBINDING NAME=\"Id\">" +
           "<KEYVALUE VALUETYPE=\"string\">" + id +
           "</KEYVALUE></KEYBINDING></INSTANCENAME></VALUE.REFERENCE></PROPERTY.REFERENCE>\n";
}

std::string Instances()
{
    return Object("INSTANCE", "CLASSNAME=\"KALMO_OperatingSystem\"",
                  Property("Name", "string", "host") + Property("OSType", "uint16", "36")) +
           Object(
               "INSTANCE", "CLASSNAME=\"Disk\"",
               Property("Id", "string", "sda") + Property("Size", "uint64", "18446744073709551615") +
                   Property("Load", "real64", "0.25") + Property("Online", "boolean", "TRUE") +
                   Property("Temperature", "sint16", "-5") + Property("Seen", "datetime", "20240229120000.000000+060") +
                   Property("Drive", "char16", "C") + Property("Ratio", "real32", "1.5") +
                   "<PROPERTY.ARRAY NAME=\"Labels\" TYPE=\"string\"><VALUE.ARRAY><VALUE>boot</VALUE><VALUE.NULL/></VALUE.ARRAY>"
                   "</PROPERTY.ARRAY>\n" +
                   "<PROPERTY NAME=\"Settings\" TYPE=\"string\" EmbeddedObject=\"instance\"><VALUE><![CDATA[<INSTANCE "
                   "CLASSNAME=\"Setting\"><PROPERTY NAME=\"Mode\" TYPE=\"uint8\"><VALUE>7</VALUE></PROPERTY></INSTANCE>]]></VALUE>"
                   "</PROPERTY>\n") +
           Object("INSTANCE", "CLASSNAME=\"Disk\"", Property("Id", "string", "sdb\\\"'%_") + Property("Size", "uint64", "0")) +
           Object("INSTANCE", "CLASSNAME=\"Port\"", Property("Id", "string", "sda") + Property("Slot", "uint8", "1")) +
           Object("INSTANCE", "CLASSNAME=\"Cable\"", ReferenceTo("From", "sda") + ReferenceTo("To", "nowhere"));
}

}  // namespace

const std::string& GetSampleDocument()
{
    static const std::string fgDocument =
        "<?xml version=\"1.0\"?>\n<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>\n" + Classes() + Instances() +
        "</DECLGROUP></DECLARATION></CIM>\n";
    return fgDocument;
}

boost::shared_ptr<TInMemNamespace> LoadSample()
{
    const boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
    const std::string& document = GetSampleDocument();
    TCimXmlPopulator(ns).LoadFromMemory(document.data(), document.size(), "sample.xml");
    return ns;
}

std::string WriteDocument(ICIMNamespace& ns)
{
    std::string document;
    TCimXmlWriter([&document](std::string_view piece) { document.append(piece); }).WriteNamespace(ns, "root/written");
    return document;
}

}  // namespace NORVZEL20
