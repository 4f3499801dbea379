#include <gtest/gtest.h>

#include <cmath>
#include <cstdlib>
#include <fstream>
#include <map>
#include <nlohmann/json.hpp>
#include <regex>
#include <string>

#include "embedded/value/TEmbeddedObject.h"
#include "host/TZELException.h"
#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

using TType = TCIMValue::TCIMType;
using TJson = nlohmann::json;

const std::string kPywbem = CIMDELTA_TEST_DATA "/interchange-pywbem/";
const std::string kOpenPegasus = CIMDELTA_TEST_DATA "/interchange-openpegasus/";

/// The list's spelling of a path as the store gives it: own namespace and host left out, char16 in single quotes.
std::string Normalized(std::string path)
{
    for (const char* own : {"//peer.example.com:5989/root/cimv2:", "root/cimv2:"}) {
        for (std::size_t place = path.find(own); place != std::string::npos; place = path.find(own)) {
            path.erase(place, std::string(own).size());
        }
    }
    return std::regex_replace(path, std::regex("k_char16=\\\\*\"(.)\\\\*\""), "k_char16='$1'");
}

bool Matches(const TCIMValue& value, const TJson& expected);

bool MatchesReal(const TCIMValue& value, const TJson& expected)
{
    double number = expected.is_string() ? std::strtod(expected.get<std::string>().c_str(), nullptr) : expected.get<double>();
    if (value.GetType() == TType::kReal32) {
        number = static_cast<double>(static_cast<float>(number));
    }
    const double real = value.GetReal();
    return (std::isnan(number) && std::isnan(real)) || (number == real && std::signbit(number) == std::signbit(real));
}

bool MatchesText(const TCIMValue& value, const TJson& expected)
{
    const auto object = value.GetEmbeddedObject();
    if (expected.is_string()) {
        return !object && value.GetString() == expected.get<std::string>();
    }
    if (!object || object->IsClass() != expected.contains("$class")) {
        return false;
    }
    if (object->GetClassName() != expected.at(object->IsClass() ? "$class" : "$instance").get<std::string>()) {
        return false;
    }
    if (object->IsClass()) {
        return true;
    }
    for (const auto& [name, property] : expected.at("properties").items()) {
        if (!object->FindProperty(name) || !Matches(object->FindProperty(name)->value, property.at("value"))) {
            return false;
        }
    }
    return true;
}

bool Matches(const TCIMValue& value, const TJson& expected)
{
    if (value.IsNull() || expected.is_null()) {
        return value.IsNull() && expected.is_null();
    }
    if (value.GetType().IsArray()) {
        const std::vector<TCIMValue>& elements = value.GetElements();
        return expected.is_array() && std::equal(elements.begin(), elements.end(), expected.begin(), expected.end(), Matches);
    }
    switch (value.GetType()) {
    case TType::kBoolean:
        return expected.is_boolean() && value.GetBoolean() == expected.get<bool>();
    case TType::kUint8:
    case TType::kUint16:
    case TType::kUint32:
    case TType::kUint64:
        return expected.is_number_unsigned() && value.GetUnsigned() == expected.get<std::uint64_t>();
    case TType::kSint8:
    case TType::kSint16:
    case TType::kSint32:
    case TType::kSint64:
        return expected.is_number_integer() && value.GetSigned() == expected.get<std::int64_t>();
    case TType::kReal32:
    case TType::kReal64:
        return MatchesReal(value, expected);
    case TType::kReference:
        return value.ToText() == Normalized(expected.at("$path").get<std::string>());
    case TType::kString:
        return MatchesText(value, expected);
    default:
        return value.ToText() == expected.get<std::string>();
    }
}

/// What the list says of all instances, by their normalized paths.
const std::map<std::string, TJson>& Expected()
{
    static const auto expected = [] {
        std::map<std::string, TJson> byPath;
        std::ifstream file(kPywbem + "expected.json");
        const TJson list = TJson::parse(file);
        for (const TJson& instance : list.at("instances")) {
            byPath.emplace(Normalized(instance.at("path").get<std::string>()), instance.at("properties"));
        }
        return byPath;
    }();
    return expected;
}

/// Compares every property of every instance with the list; returns how many instances there were.
std::size_t CompareWithList(const TLoading& loading)
{
    std::size_t count = 0;
    const auto compare = [&](const boost::shared_ptr<ICIMInstance>& instance) {
        ++count;
        const std::string path = Normalized(instance->GetReference(TCallContext()).GetPath());
        const auto expected = Expected().find(path);
        if (expected == Expected().end()) {
            ADD_FAILURE() << "not in the list: " << path;
            return true;
        }
        const auto compareProperty = [&](const boost::shared_ptr<ICIMProperty>& property) {
            const std::string name = property->GetPropertyDecl(TCallContext())->GetName(TCallContext());
            const TCIMValue& value = property->GetValue(TCallContext());
            const auto listed = expected->second.find(name);
            const bool isEqual = listed == expected->second.end() ? value.IsNull() : Matches(value, listed->at("value"));
            EXPECT_TRUE(isEqual) << path << " " << name << " is " << value.ToText();
            return true;
        };
        instance->EnumerateProperties(compareProperty, TCallContext());
        return true;
    };
    for (const boost::shared_ptr<TInMemClass>& cls : loading.GetNamespace()->GetClasses()) {
        cls->EnumerateInstances(compare, false, TCallContext());
    }
    return count;
}

std::size_t CountInstances(const TLoading& loading)
{
    std::size_t count = 0;
    for (const boost::shared_ptr<TInMemClass>& cls : loading.GetNamespace()->GetClasses()) {
        count += cls->GetInstanceCount();
    }
    return count;
}

void ExpectSameAfterWriting(const TLoading& loading)
{
    const std::string written = loading.Write();
    TLoading again;
    const TLoadReport report = again.Load(written);
    EXPECT_EQ(loading.GetNamespace()->GetQualifierDecls().size(), report.qualifierDecls);
    EXPECT_EQ(loading.GetNamespace()->GetClasses().size(), report.classes);
    EXPECT_EQ(CountInstances(loading), report.instances);
    EXPECT_EQ(written, again.Write());
}

struct TDocumentRow {
    const char* name;
    const char* before;  ///< the document that declares the classes which it lacks; null if it lacks none
    std::size_t instances;
};

class PywbemDocumentTest : public testing::TestWithParam<TDocumentRow> {};

TEST_P(PywbemDocumentTest, HoldsWhatTheListSaysAndComesBackEqual)
{
    TLoading loading;
    if (GetParam().before != nullptr) {
        loading.LoadFile(kPywbem + GetParam().before);
    }
    loading.LoadFile(kPywbem + GetParam().name);
    EXPECT_EQ(GetParam().instances, CompareWithList(loading));
    ExpectSameAfterWriting(loading);
}

INSTANTIATE_TEST_SUITE_P(All, PywbemDocumentTest,
                         testing::Values(TDocumentRow{"01-qualifiers.xml", nullptr, 0}, TDocumentRow{"02-classes.xml", nullptr, 0},
                                         TDocumentRow{"03-instances.xml", "02-classes.xml", 90},
                                         TDocumentRow{"04-all-in-one.xml", nullptr, 90},
                                         TDocumentRow{"05-withname.xml", nullptr, 90},
                                         TDocumentRow{"06-withpath.xml", "02-classes.xml", 90},
                                         TDocumentRow{"07-three-groups.xml", nullptr, 10},
                                         TDocumentRow{"08-response-enumerateinstances.xml", "02-classes.xml", 90},
                                         TDocumentRow{"09-response-pull.xml", "02-classes.xml", 90},
                                         TDocumentRow{"12-instances-indented.xml", nullptr, 15},
                                         TDocumentRow{"13-instances-utf16.xml", "02-classes.xml", 90},
                                         TDocumentRow{"14-instances-latin1.xml", "02-classes.xml", 82},
                                         TDocumentRow{"15-instances-cdata.xml", nullptr, 90},
                                         TDocumentRow{"16-arrays-null-as-empty-value.xml", "02-classes.xml", 6}));

TEST(PywbemResponseTest, AClassAloneNeedsItsSuperclass)
{
    TLoading loading;
    EXPECT_NE("", [&] {
        try {
            loading.LoadFile(kPywbem + "10-response-getclass.xml");
            return std::string();
        } catch (const TZELException& error) {
            return std::string(error.what());
        }
    }());
    loading.LoadFile(kOpenPegasus + "root_tstdev/GetClass.TST_Base.xml");
    EXPECT_EQ(1u, loading.LoadFile(kPywbem + "10-response-getclass.xml").classes);
    ExpectSameAfterWriting(loading);
}

TEST(PywbemResponseTest, ARecordedErrorIsAnError)
{
    TLoading loading;
    try {
        loading.LoadFile(kPywbem + "11-response-error.xml");
        FAIL();
    } catch (const TZELException& error) {
        EXPECT_EQ(kPywbem + "11-response-error.xml:2:128: found an error as the answer to \"GetInstance\": CIM_ERR_NOT_FOUND (6), "
                            "\"not <found> & gone\"; expected an answer with objects; correct the name in the request",
                  error.what());
    }
}

TEST(OpenPegasusTest, InventoriesComeBackEqual)
{
    const std::pair<const char*, std::size_t> rows[] = {{"root_deb/inventory.xml", 167}, {"root_tstdev/inventory.xml", 85}};
    for (const auto& [name, instances] : rows) {
        TLoading loading;
        EXPECT_EQ(instances, loading.LoadFile(kOpenPegasus + name).instances) << name;
        ExpectSameAfterWriting(loading);
    }
}

TEST(OpenPegasusTest, ResponsesBuildTheSameNamespaceAsTheInventory)
{
    TLoading inventory;
    inventory.LoadFile(kOpenPegasus + "root_deb/inventory.xml");
    TLoading responses;
    for (const char* name : {"EnumerateQualifiers", "GetClass.DEB_Package", "GetClass.DEB_PackageDependency",
                             "EnumerateInstances.DEB_Package", "EnumerateInstances.DEB_PackageDependency"}) {
        responses.LoadFile(kOpenPegasus + "root_deb/" + name + ".xml");
    }
    EXPECT_EQ(inventory.PathsOf("DEB_Package"), responses.PathsOf("DEB_Package"));
    EXPECT_EQ(inventory.PathsOf("DEB_PackageDependency"), responses.PathsOf("DEB_PackageDependency"));
}

TEST(TypePairTest, BothInventoriesComeBackEqual)
{
    for (const char* name : {"A.xml", "B.xml"}) {
        TLoading loading;
        EXPECT_EQ(231u, loading.LoadFile(std::string(CIMDELTA_TEST_DATA "/typepair/") + name).instances);
        ExpectSameAfterWriting(loading);
    }
}

}  // namespace
}  // namespace NORVZEL20
