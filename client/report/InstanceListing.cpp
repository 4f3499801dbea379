// What `query` and `show` write. Instances of two properties, as text and as JSON:
//
//   Disk.Id="sda"                  { "class": "Disk", "instance": "Disk.Id=\"sda\"", "properties": { "Id": "sda", "Size": 500 } }
//       Id: sda
//       Size: 500
//
// JSON is one array of these, NDJSON a line for each. CIM-XML is different: it cannot leave out properties, and must bring along
// the declarations without which it would not load.
#include "client/report/InstanceListing.h"

#include <set>

#include "client/inventory/CollectObjects.h"
#include "client/inventory/FindDeclarations.h"
#include "client/report/JsonValue.h"
#include "client/text/Counted.h"
#include "client/text/DisplayText.h"
#include "embedded/cimxml/TCimXmlWriter.h"

namespace NORVZEL20 {

namespace {

using TJson = nlohmann::ordered_json;

std::vector<boost::shared_ptr<ICIMProperty>> PropertiesToWrite(const ICIMInstance& instance, const std::vector<std::string>& names)
{
    if (names.empty()) {
        return PropertiesOf(instance);
    }
    // The class of an instance may lack a property that the query names, because another class below the queried one has it.
    std::vector<boost::shared_ptr<ICIMProperty>> properties;
    for (const std::string& name : names) {
        if (FindPropertyDecl(*instance.GetClass(TCallContext()), name)) {
            properties.push_back(instance.GetProperty(name, TCallContext()));
        }
    }
    return properties;
}

const std::string& NameOf(const ICIMProperty& property)
{
    return property.GetPropertyDecl(TCallContext())->GetName(TCallContext());
}

// Without the namespace, which is the same for all instances of a listing.
std::string PathOf(const ICIMInstance& instance)
{
    TCIMReference path = instance.GetReference(TCallContext());
    path.SetNamespaceName(std::string());
    return path.GetPath();
}

std::string InstanceAsText(const ICIMInstance& instance, const std::vector<std::string>& names)
{
    std::string text = EscapeForDisplay(PathOf(instance)) + "\n";
    for (const boost::shared_ptr<ICIMProperty>& property : PropertiesToWrite(instance, names)) {
        text += "    " + EscapeForDisplay(NameOf(*property)) + ": " + DisplayValue(property->GetValue(TCallContext())) + "\n";
    }
    return text;
}

TJson InstanceAsJson(const ICIMInstance& instance, const std::vector<std::string>& names)
{
    TJson properties = TJson::object();
    for (const boost::shared_ptr<ICIMProperty>& property : PropertiesToWrite(instance, names)) {
        properties[NameOf(*property)] = JsonOf(property->GetValue(TCallContext()));
    }
    return {{"class", instance.GetClass(TCallContext())->GetName(TCallContext())},
            {"instance", PathOf(instance)},
            {"properties", properties}};
}

// One document that holds all, or one line for each of them.
std::string WriteDocuments(const TJson& documents, EOutputFormat format)
{
    if (format == EOutputFormat::kJson) {
        return WriteJson(documents, true);
    }
    std::string lines;
    for (const TJson& document : documents) {
        lines += WriteJson(document, false);
    }
    return lines;
}

// The namespace that the file named, or that was found out from its references. A copy must name it: a reference in it that names a
// namespace may mean this one or another, and a reader finds out only by this name.
std::string NamespaceNameOf(const TInventory& inventory)
{
    const TLoadReport& loaded = inventory.loaded;
    return loaded.namespaceOrigin != TLoadReport::kFromDefault || loaded.referencesNameNamespace ? loaded.namespaceName
                                                                                                 : std::string();
}

// Superclasses first, each once: a document declares a class before those below it.
void WriteClassWithSuperclasses(TCimXmlWriter& writer, const TInMemClass& cls, std::set<const TInMemClass*>& written)
{
    if (!written.insert(&cls).second) {
        return;
    }
    if (cls.GetSuperInMemClass()) {
        WriteClassWithSuperclasses(writer, *cls.GetSuperInMemClass(), written);
    }
    writer.WriteClass(cls);
}

// A document that loads by itself: qualifiers, the classes that the instances need, the instances.
std::string InstancesAsCimXml(const TInventory& inventory, const std::vector<boost::shared_ptr<ICIMInstance>>& instances)
{
    std::string text;
    TCimXmlWriter writer([&text](std::string_view piece) { text += piece; });
    writer.StartDocument(NamespaceNameOf(inventory), inventory.loaded.host);
    TInMemNamespace& ns = *inventory.ns;
    for (const boost::shared_ptr<TInMemQualifierDecl>& decl : ns.GetQualifierDecls()) {
        writer.WriteQualifierDecl(*decl);
    }
    std::set<const TInMemClass*> written;
    for (const boost::shared_ptr<ICIMInstance>& instance : instances) {
        WriteClassWithSuperclasses(writer, *ns.FindClass(instance->GetClass(TCallContext())->GetName(TCallContext())), written);
    }
    for (const boost::shared_ptr<ICIMInstance>& instance : instances) {
        writer.WriteInstance(*instance);
    }
    writer.EndDocument();
    return text;
}

std::string NamespaceAsCimXml(const TInventory& inventory)
{
    std::string text;
    TCimXmlWriter writer([&text](std::string_view piece) { text += piece; });
    writer.WriteNamespace(*inventory.ns, NamespaceNameOf(inventory), inventory.loaded.host);
    return text;
}

void AppendClassTree(std::string& text, const TInMemClass& cls, const std::string& indentation)
{
    text += indentation + EscapeForDisplay(cls.GetName()) + ": " + Counted(cls.GetInstanceCount(), "instance") + "\n";
    for (const boost::shared_ptr<TInMemClass>& sub : cls.GetSubClasses()) {
        AppendClassTree(text, *sub, indentation + "  ");
    }
}

std::string ClassesAsText(TInMemNamespace& ns)
{
    std::string text;
    for (const boost::shared_ptr<TInMemClass>& cls : ns.GetClasses()) {
        if (!cls->GetSuperInMemClass()) {
            AppendClassTree(text, *cls, "");
        }
    }
    return text;
}

TJson ClassesAsJson(TInMemNamespace& ns)
{
    TJson classes = TJson::array();
    for (const boost::shared_ptr<TInMemClass>& cls : ns.GetClasses()) {
        const boost::shared_ptr<TInMemClass> super = cls->GetSuperInMemClass();
        TJson json = {{"class", cls->GetName()}};
        json["superclass"] = super ? TJson(super->GetName()) : TJson(nullptr);
        json["instances"] = cls->GetInstanceCount();
        classes.push_back(json);
    }
    return classes;
}

}  // namespace

std::string WriteInstances(const TInventory& inventory, const std::vector<boost::shared_ptr<ICIMInstance>>& instances,
                           const std::vector<std::string>& properties, EOutputFormat format)
{
    if (format == EOutputFormat::kCimXml) {
        return InstancesAsCimXml(inventory, instances);
    }
    if (format == EOutputFormat::kText) {
        std::string text;
        for (const boost::shared_ptr<ICIMInstance>& instance : instances) {
            text += InstanceAsText(*instance, properties);
        }
        return text;
    }
    TJson documents = TJson::array();
    for (const boost::shared_ptr<ICIMInstance>& instance : instances) {
        documents.push_back(InstanceAsJson(*instance, properties));
    }
    return WriteDocuments(documents, format);
}

std::string WriteClasses(const TInventory& inventory, EOutputFormat format)
{
    if (format == EOutputFormat::kCimXml) {
        return NamespaceAsCimXml(inventory);
    }
    return format == EOutputFormat::kText ? ClassesAsText(*inventory.ns) : WriteDocuments(ClassesAsJson(*inventory.ns), format);
}

}  // namespace NORVZEL20
