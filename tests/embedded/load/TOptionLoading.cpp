#include "tests/embedded/load/TOptionLoading.h"

#include "embedded/cimxml/TCimXmlDocuments.h"
#include "embedded/load/TLoadSession.h"
#include "embedded/load/TStoredObjects.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

TOptionLoading::TOptionLoading() : fNamespace(TInMemNamespace::Create("root/test")) {}

std::string TOptionLoading::Load(const std::vector<std::string>& documents)
{
    try {
        TLoadSession session(fNamespace, "load", fOptions);
        TCimXmlDocuments reader(session);
        int number = 0;
        for (const std::string& document : documents) {
            reader.ReadMemory(document.data(), document.size(), std::to_string(++number) + ".xml");
        }
        fReport = session.Commit();
    } catch (const TPopulateError& error) {
        fAdvice = error.GetAdvice();
        return error.what();
    }
    return "";
}

std::string TOptionLoading::Declaration(const std::string& className) const
{
    const boost::shared_ptr<TInMemClass> cls = fNamespace->FindClass(className);
    if (!cls) {
        return "";
    }
    const TEmbeddedObject object = TStoredObjects::FromClass(*cls);
    const auto qualifiers = [](const std::vector<TEmbeddedObject::TQualifier>& all) {
        std::string names;
        for (const TEmbeddedObject::TQualifier& qualifier : all) {
            names += " " + qualifier.name;
        }
        return names + "\n";
    };
    std::string text = object.GetClassName() + (object.GetSuperClassName().empty() ? "" : " : " + object.GetSuperClassName()) +
                       qualifiers(object.GetQualifiers());
    for (const TEmbeddedObject::TProperty& property : object.GetProperties()) {
        text += "  " + property.name + " " + TValueText::DescribeType(property.value.GetType()) + qualifiers(property.qualifiers);
    }
    return text;
}

std::string TOptionLoading::PathsOf(const std::string& className) const
{
    std::string paths;
    const auto add = [&paths](const boost::shared_ptr<ICIMInstance>& instance) {
        paths += instance->GetReference(TCallContext()).ToText() + "\n";
        return true;
    };
    fNamespace->GetClass(className, TCallContext())->EnumerateInstances(add, false, TCallContext());
    return paths;
}

std::string TOptionLoading::Document(const std::string& contents)
{
    return "<CIM><DECLARATION><DECLGROUP>" + contents + "</DECLGROUP></DECLARATION></CIM>";
}

}  // namespace NORVZEL20
