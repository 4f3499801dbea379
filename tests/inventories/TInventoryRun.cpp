#include "tests/inventories/TInventoryRun.h"

#include <nlohmann/json.hpp>

#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdio>
#include <fstream>
#include <stdexcept>

#include "client/inventory/TInventoryFile.h"
#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/cimxml/TCimXmlWriter.h"
#include "embedded/store/TInMemInstance.h"
#include "embedded/store/TInMemProperty.h"
#include "host/TNamespaceProviderManager.h"

namespace NORVZEL20 {
namespace {

using TJson = nlohmann::json;

// Every comparison reads the type of the operating system first. These inventories have no such instance, so one is added.
const char kOperatingSystem[] =
    "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP><VALUE.OBJECT><CLASS NAME=\"KALMO_OperatingSystem\">"
    "<PROPERTY NAME=\"Name\" TYPE=\"string\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>"
    "<PROPERTY NAME=\"OSType\" TYPE=\"uint16\"/></CLASS></VALUE.OBJECT><VALUE.OBJECT><INSTANCE CLASSNAME=\"KALMO_OperatingSystem\">"
    "<PROPERTY NAME=\"Name\" TYPE=\"string\"><VALUE>os</VALUE></PROPERTY><PROPERTY NAME=\"OSType\" "
    "TYPE=\"uint16\"><VALUE>36</VALUE>"
    "</PROPERTY></INSTANCE></VALUE.OBJECT></DECLGROUP></DECLARATION></CIM>";

TJson ToJson(const TCIMValue& value)
{
    if (value.IsNull()) {
        return nullptr;
    }
    const TCIMValue::TCIMType type = value.GetType();
    if (type.IsArray()) {
        TJson array = TJson::array();
        for (const TCIMValue& element : value.GetElements()) {
            array.push_back(ToJson(element));
        }
        return array;
    }
    switch (type) {
    case TCIMValue::TCIMType::kBoolean:
        return value.GetBoolean();
    case TCIMValue::TCIMType::kUint64:
        return value.GetUnsigned();
    case TCIMValue::TCIMType::kString:
        return std::string(value.GetString());
    default:
        throw std::runtime_error("no JSON form for a value of this type");
    }
}

TCIMValue ValueOf(ICIMInstance& record, const char* property)
{
    return record.GetProperty(property, TCallContext())->GetValue(TCallContext());
}

boost::shared_ptr<TInMemNamespace> LoadWithOperatingSystem(const std::string& path)
{
    const boost::shared_ptr<TInMemNamespace> ns = LoadInventory(path);
    TCimXmlPopulator(ns).LoadFromMemory(kOperatingSystem, sizeof kOperatingSystem - 1, "operating system");
    return ns;
}

}  // namespace

boost::shared_ptr<TInMemNamespace> LoadInventory(const std::string& path)
{
    const boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
    TInventoryFile file(path);
    TCimXmlPopulator(ns).LoadFromSource([&file](char* buffer, std::size_t size) { return file.Read(buffer, size); }, path);
    return ns;
}

boost::shared_ptr<TInMemNamespace> LoadInventoryText(const std::string& xml)
{
    const boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
    TCimXmlPopulator(ns).LoadFromMemory(xml.data(), xml.size(), "text");
    return ns;
}

std::string WriteInventory(TInMemNamespace& ns)
{
    std::string xml;
    TCimXmlWriter([&xml](std::string_view piece) { xml += piece; }).WriteNamespace(ns);
    return xml;
}

TInventoryRun::TInventoryRun(const std::string& reference, const std::string& other)
    : fReference(LoadWithOperatingSystem(reference)), fOther(LoadWithOperatingSystem(other)),
      fDelta(boost::dynamic_pointer_cast<TDeltaNamespace>(
          TNamespaceProviderManager::GetInstance()->FindProvider("delta")->AllocateNamespace(TCallContext(), false, "delta")))
{}

void TInventoryRun::Compare(const std::vector<std::string>& classes)
{
    const std::string rules = testing::TempDir() + "inventory-rules-" + std::to_string(getpid());
    std::ofstream file(rules);
    file << "<DifftoolSpec version=\"1.0\">";
    for (const std::string& cls : classes) {
        file << "<class name=\"" << cls << "\" default=\"include\"/>";
    }
    file << "</DifftoolSpec>";
    file.close();
    fDelta->SetSpecFileName(rules);
    fDelta->AddNamespaceToCompareList(fReference);
    fDelta->AddNamespaceToCompareList(fOther);
    fDelta->FindDifferences();
    std::remove(rules.c_str());
}

std::set<std::string> TInventoryRun::Differences(bool withValues) const
{
    std::set<std::string> differences;
    std::string language = "WQL";
    std::string query = "SELECT * FROM KALMO_Delta";
    fDelta->ExecuteQuery(
        [&](const boost::shared_ptr<ICIMInstance>& record) {
            differences.insert(Describe(*record, withValues));
            return true;
        },
        language, query, TCallContext());
    return differences;
}

std::string TInventoryRun::Describe(ICIMInstance& record, bool withValues) const
{
    const std::string path(ValueOf(record, "InstanceName").GetString());
    switch (ValueOf(record, "Type").GetUnsigned()) {
    case TDeltaNamespace::kInstanceRemoved:
        return "A_ONLY " + path;
    case TDeltaNamespace::kInstanceAdded:
        return "B_ONLY " + path;
    default:
        const std::string property(ValueOf(record, "Property").GetString());
        return "DIFF " + path + " " + property + (withValues ? ValuesOf(path, property) : "");
    }
}

std::string TInventoryRun::ValuesOf(const std::string& path, const std::string& property) const
{
    const TCIMReference reference = TCIMReference::Parse(path, fReference);
    const TInMemProperty& changed = *fReference->FindInstance(reference)->FindProperty(property);
    const TCIMValue& other = fOther->FindInstance(reference)->FindProperty(property)->GetValue();
    if (changed.GetEarlierValue() == nullptr || changed.GetValue() != other) {
        throw std::runtime_error("the reference was not brought in line: " + path + " " + property);
    }
    return ": " + ToJson(*changed.GetEarlierValue()).dump() + " -> " + ToJson(other).dump();
}

}  // namespace NORVZEL20
