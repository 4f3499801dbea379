#include "tests/embedded/cimxml/TLoading.h"

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/cimxml/TCimXmlWriter.h"

namespace NORVZEL20 {

TLoading::TLoading() : fNamespace(TInMemNamespace::Create("root/cimv2")) {}

TLoadReport TLoading::Load(const std::string& document)
{
    return Keep(TCimXmlPopulator(fNamespace).LoadFromMemory(document.data(), document.size(), "doc.xml"));
}

TLoadReport TLoading::LoadFile(const std::string& path)
{
    return Keep(TCimXmlPopulator(fNamespace).LoadFile(path));
}

TLoadReport TLoading::Keep(TLoadReport report)
{
    if (report.namesNamespace || report.referencesNameNamespace) {
        fName = report.namespaceName;
    }
    return report;
}

std::string TLoading::ErrorOf(const std::string& document)
{
    try {
        Load(document);
        return std::string();
    } catch (const TPopulateError& error) {
        return error.what();
    }
}

int TLoading::StatusOf(const std::string& document)
{
    try {
        Load(document);
        return 0;
    } catch (const TZELException& error) {
        return error.GetStatusCode().GetStatus();
    }
}

boost::shared_ptr<ICIMInstance> TLoading::Find(const std::string& path) const
{
    return fNamespace->GetInstance(TCIMReference::Parse(path), TCallContext());
}

std::string TLoading::ValueOf(const std::string& path, const std::string& property) const
{
    return Find(path)->GetProperty(property, TCallContext())->GetValue(TCallContext()).ToText();
}

std::string TLoading::PathsOf(const std::string& className) const
{
    std::string paths;
    const auto append = [&](const boost::shared_ptr<ICIMInstance>& instance) {
        paths += instance->GetReference(TCallContext()).GetPath() + "\n";
        return true;
    };
    fNamespace->GetClass(className, TCallContext())->EnumerateInstances(append, false, TCallContext());
    return paths;
}

std::string TLoading::Write() const
{
    std::string text;
    TCimXmlWriter writer([&](std::string_view piece) { text += piece; });
    writer.WriteNamespace(*fNamespace, fName);
    return text;
}

std::string TLoading::Group(const std::string& contents)
{
    return "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>\n" + contents +
           "</DECLGROUP></DECLARATION></CIM>\n";
}

std::string TLoading::Class(const std::string& name, const std::string& properties)
{
    return "<VALUE.OBJECT><CLASS NAME=\"" + name +
           "\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\" OVERRIDABLE=\"false\">"
           "<VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>" +
           properties + "</CLASS></VALUE.OBJECT>\n";
}

std::string TLoading::Instance(const std::string& className, const std::string& id, const std::string& properties)
{
    return "<VALUE.OBJECT><INSTANCE CLASSNAME=\"" + className + "\">" + Property("Id", "string", id) + properties +
           "</INSTANCE></VALUE.OBJECT>\n";
}

std::string TLoading::Property(const std::string& name, const std::string& type, const std::string& value)
{
    return "<PROPERTY NAME=\"" + name + "\" TYPE=\"" + type + "\"><VALUE>" + value + "</VALUE></PROPERTY>";
}

std::string TLoading::Array(const std::string& name, const std::string& type, const std::vector<std::string>& values)
{
    std::string elements;
    for (const std::string& value : values) {
        elements += "<VALUE>" + value + "</VALUE>";
    }
    return "<PROPERTY.ARRAY NAME=\"" + name + "\" TYPE=\"" + type + "\"><VALUE.ARRAY>" + elements +
           "</VALUE.ARRAY></PROPERTY.ARRAY>";
}

std::string TLoading::Tolerated(const TLoadReport& report)
{
    std::string lines;
    for (const TLoadReport::TTolerated& tolerated : report.tolerated) {
        lines += std::to_string(tolerated.line) + ": " + tolerated.text + " (" + std::to_string(tolerated.count) + ")\n";
    }
    return lines;
}

}  // namespace NORVZEL20
