#include "client/inventory/NotCollected.h"

#include <utility>

#include "client/inventory/CollectObjects.h"
#include "embedded/cimxml/TCimXmlWriter.h"
#include "embedded/store/TInMemInstance.h"
#include "embedded/value/TValueXml.h"

namespace NORVZEL20 {

const char* const kNotCollectedClass = "KALMO_NotCollected";

namespace {

const char kDeclaration[] =
    "<VALUE.OBJECT><CLASS NAME=\"KALMO_NotCollected\">"
    "<PROPERTY NAME=\"Kind\" TYPE=\"string\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>"
    "<PROPERTY NAME=\"Reason\" TYPE=\"string\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>"
    "<PROPERTY NAME=\"Count\" TYPE=\"uint32\"></PROPERTY>"
    "<PROPERTY.ARRAY NAME=\"Subjects\" TYPE=\"string\"></PROPERTY.ARRAY>"
    "<PROPERTY NAME=\"Others\" TYPE=\"uint32\"></PROPERTY>"
    "</CLASS></VALUE.OBJECT>\n";

void AppendText(std::string& xml, const char* name, const std::string& type, const std::string& value)
{
    xml += "<PROPERTY";
    TValueXml::AppendAttribute(xml, "NAME", name);
    TValueXml::AppendAttribute(xml, "TYPE", type);
    xml += "><VALUE>";
    TValueXml::AppendEscaped(xml, value);
    xml += "</VALUE></PROPERTY>";
}

void AppendNotCollected(std::string& xml, const TNotCollected& entry)
{
    xml += "<VALUE.OBJECT><INSTANCE CLASSNAME=\"KALMO_NotCollected\">";
    AppendText(xml, "Kind", "string", entry.kind);
    AppendText(xml, "Reason", "string", entry.reason);
    AppendText(xml, "Count", "uint32", std::to_string(entry.count));
    xml += "<PROPERTY.ARRAY NAME=\"Subjects\" TYPE=\"string\"><VALUE.ARRAY>";
    for (const std::string& subject : entry.subjects) {
        xml += "<VALUE>";
        TValueXml::AppendEscaped(xml, subject);
        xml += "</VALUE>";
    }
    xml += "</VALUE.ARRAY></PROPERTY.ARRAY></INSTANCE></VALUE.OBJECT>\n";
}

// The value of a property; null if it is not declared as that type.
TCIMValue ValueOfType(const TInMemInstance& instance, const char* name, TCIMValue::TCIMType type)
{
    const TInMemLayout& layout = instance.GetInMemClass()->GetLayout();
    const std::uint32_t slot = layout.FindSlot(name);
    return slot != TInMemLayout::kNoSlot && layout.GetDecl(slot).GetType() == type ? instance.GetSlotValue(slot) : TCIMValue();
}

std::string TextOf(const TCIMValue& value)
{
    return value.IsNull() || value.GetEmbeddedObject() ? std::string() : std::string(value.GetString());
}

TNotCollected ReadNotCollected(const TInMemInstance& instance)
{
    using TType = TCIMValue::TCIMType;
    TNotCollected entry;
    entry.kind = TextOf(ValueOfType(instance, "Kind", TType::kString));
    entry.reason = TextOf(ValueOfType(instance, "Reason", TType::kString));
    const TCIMValue subjects = ValueOfType(instance, "Subjects", TType(TType::kString).GetArrayType());
    if (!subjects.IsNull()) {
        for (const TCIMValue& subject : subjects.GetElements()) {
            entry.subjects.push_back(TextOf(subject));
        }
    }
    const TCIMValue count = ValueOfType(instance, "Count", TType::kUint32);
    entry.count = count.IsNull() ? entry.subjects.size() : static_cast<std::size_t>(count.GetUnsigned());
    return entry;
}

}  // namespace

std::vector<TNotCollected> FindNotCollected(TInMemNamespace& ns)
{
    std::vector<TNotCollected> all;
    const boost::shared_ptr<TInMemClass> cls = ns.FindClass(kNotCollectedClass);
    if (!cls) {
        return all;
    }
    for (const boost::shared_ptr<ICIMInstance>& instance : InstancesOf(*cls)) {
        TNotCollected entry = ReadNotCollected(static_cast<const TInMemInstance&>(*instance));
        if (!entry.kind.empty() && !entry.reason.empty()) {
            all.push_back(std::move(entry));
        }
    }
    return all;
}

std::string WriteNotCollected(const std::string& namespaceName, const std::vector<TNotCollected>& all, bool declares)
{
    std::string xml;
    TCimXmlWriter writer([&xml](std::string_view piece) { xml += piece; });
    writer.StartDocument(namespaceName);
    writer.EndDocument();
    std::string objects = declares && !all.empty() ? kDeclaration : "";
    for (const TNotCollected& entry : all) {
        AppendNotCollected(objects, entry);
    }
    return xml.insert(xml.find("</DECLGROUP"), objects);
}

}  // namespace NORVZEL20
