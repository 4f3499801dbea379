#include <nlohmann/json.hpp>

#include "tests/client/Documents.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

/// The formats for programs. Their texts are part of the contract, so they are compared letter by letter.
class FormatsTest : public TClientFixture {
  protected:
    /// What is said of a class under rules that neither leave properties out nor exclude keys.
    static std::string CoveredClass(const std::string& name, const std::string& state, const std::string& instances,
                                    const std::string& compared)
    {
        return "{\"class\":\"" + name + "\",\"state\":\"" + state + "\",\"instances\":[" + instances +
               "],\"propertiesLeftOut\":[],\"excludedKeys\":[],\"sharingKeys\":[0,0,0],\"instancesCompared\":[" + compared +
               "],\"ignoredKeys\":[],\"sharingKeysWithoutPartner\":[0,0,0],\"referencesReduced\":false,"
               "\"referenceKeysLeftOut\":[],\"leftOutReasons\":[]}";
    }

    static std::string Inventory(const std::string& label, const std::string& role, int differences)
    {
        return "{\"label\":\"" + label + "\",\"file\":\"" + label + ".xml\",\"role\":\"" + role +
               "\",\"instancesCompared\":2,\"differences\":" + std::to_string(differences) +
               ",\"namespace\":\"root/cimv2\",\"namespaceFrom\":\"default\",\"inferredClasses\":[]}";
    }

    /// One property of the service changed in one inventory.
    static std::string GroupOfService(const std::string& property, const std::string& label, const std::string& before,
                                      const std::string& after)
    {
        return "{\"class\":\"INV_Service\",\"kind\":\"changed\",\"property\":\"" + property + "\",\"inventories\":[\"" + label +
               "\"],\"instances\":1,\"distinctChanges\":1,\"changes\":[{\"instances\":1,\"reference\":{\"type\":" + before +
               "},\"others\":[{\"inventories\":[\"" + label + "\"],\"type\":" + after +
               "}],\"examples\":[\"INV_Service.Id=\\\"ssh\\\"\"]}]}";
    }
};

/// The four differences of the three systems.
const char kDifferences[] =
    "{\"kind\":\"onlyInReference\",\"class\":\"INV_Disk\",\"instance\":\"INV_Disk.BootId=1,Device=\\\"sda\\\"\",\"keys\":"
    "{\"Device\":\"sda\",\"BootId\":1},"
    "\"inventories\":[\"web02\"],\"contents\":{\"SizeMB\":{\"type\":\"uint32\",\"value\":500},"
    "\"Model\":{\"type\":\"string\",\"value\":\"A 1\"}}}\n"
    "{\"kind\":\"onlyInOthers\",\"class\":\"INV_Disk\",\"instance\":\"INV_Disk.BootId=7,Device=\\\"sda\\\"\",\"keys\":{"
    "\"Device\":\"sda\",\"BootId\":7},"
    "\"inventories\":[\"web02\"],\"contents\":{\"SizeMB\":{\"type\":\"uint32\",\"value\":500},"
    "\"Model\":{\"type\":\"string\",\"value\":\"A 1\"}}}\n"
    "{\"kind\":\"changed\",\"class\":\"INV_Service\",\"instance\":\"INV_Service.Id=\\\"ssh\\\"\",\"keys\":{\"Id\":"
    "\"ssh\"},\"inventories\":[\"web03\"],"
    "\"property\":\"Caption\",\"reference\":{\"type\":\"string\",\"value\":\"Secure shell\"},"
    "\"others\":[{\"inventories\":[\"web03\"],\"type\":\"string\",\"value\":\"Secure\\nshell \u009b31m\"}]}\n"
    "{\"kind\":\"changed\",\"class\":\"INV_Service\",\"instance\":\"INV_Service.Id=\\\"ssh\\\"\",\"keys\":{\"Id\":"
    "\"ssh\"},\"inventories\":[\"web02\"],"
    "\"property\":\"Started\",\"reference\":{\"type\":\"boolean\",\"value\":true},"
    "\"others\":[{\"inventories\":[\"web02\"],\"type\":\"boolean\",\"value\":false}]}\n";

TEST_F(FormatsTest, NdjsonHasADocumentForEachDifferenceAndOneForTheCoverage)
{
    const std::string coverage =
        std::string("{\"kind\":\"coverage\",\"inventories\":[") + Inventory("web01", "reference", 0) + "," +
        Inventory("web02", "other", 3) + "," + Inventory("web03", "other", 1) +
        "],\"summary\":{\"differences\":4,\"onlyInReference\":1,\"onlyInOthers\":1,\"changedValues\":2,\"changedInstances\":1,"
        "\"instancesOnlyInOthers\":1,\"everythingCompared\":false,\"nothingCompared\":false,\"classes\":["
        "{\"class\":\"INV_Disk\",\"onlyInReference\":1,\"onlyInOthers\":1,\"changedValues\":0,\"changedInstances\":0},"
        "{\"class\":\"INV_Service\",\"onlyInReference\":0,\"onlyInOthers\":0,\"changedValues\":2,\"changedInstances\":1}]},"
        "\"groups\":["
        "{\"class\":\"INV_Disk\",\"kind\":\"onlyInReference\",\"inventories\":[\"web02\"],\"instances\":1,"
        "\"examples\":[\"INV_Disk.BootId=1,Device=\\\"sda\\\"\"]},"
        "{\"class\":\"INV_Disk\",\"kind\":\"onlyInOthers\",\"inventories\":[\"web02\"],\"instances\":1,"
        "\"examples\":[\"INV_Disk.BootId=7,Device=\\\"sda\\\"\"]}," +
        GroupOfService("Caption", "web03", "\"string\",\"value\":\"Secure shell\"",
                       "\"string\",\"value\":\"Secure\\nshell \u009b31m\"") +
        "," + GroupOfService("Started", "web02", "\"boolean\",\"value\":true", "\"boolean\",\"value\":false") +
        "],"
        "\"classes\":[" +
        CoveredClass("INV_Disk", "compared", "1,1,1", "1,1,1") + "," +
        CoveredClass("INV_Package", "reachedByNoElement", "3,3,4", "0,0,0") + "," +
        CoveredClass("INV_Service", "compared", "1,1,1", "1,1,1") + "," +
        CoveredClass("KALMO_OperatingSystem", "reachedByNoElement", "1,1,1", "0,0,0") +
        "],\"classesWithoutInstances\":1,\"schema\":[],\"badValues\":[],\"systemNames\":[],\"hints\":[]}\n";
    EXPECT_EQ(kDifferences + coverage,
              Result({"compare", "--detail", "-o", "ndjson", "--spec",
                      Scratch("rules", "<DifftoolSpec><class name='INV_Disk' default='include'/><class name='INV_Element' "
                                       "default='include'/></DifftoolSpec>"),
                      "web01.xml", "web02.xml", "web03.xml"}));
}

TEST_F(FormatsTest, JsonHoldsWhatNdjsonHolds)
{
    const std::vector<std::string> inventories = {"web01.xml", "web02.xml", "web03.xml"};
    const nlohmann::ordered_json document = nlohmann::ordered_json::parse(
        Result({"compare", "--detail", "-o", "json", inventories[0], inventories[1], inventories[2]}));
    const std::string lines = Result({"compare", "--detail", "-o", "ndjson", inventories[0], inventories[1], inventories[2]});
    std::string rebuilt;
    for (const nlohmann::ordered_json& difference : document["differences"]) {
        rebuilt += difference.dump() + "\n";
    }
    nlohmann::ordered_json coverage = {{"kind", "coverage"},
                                       {"inventories", document["inventories"]},
                                       {"summary", document["summary"]},
                                       {"groups", document["groups"]}};
    coverage.update(document["coverage"]);
    EXPECT_EQ(lines, rebuilt + coverage.dump() + "\n");
    EXPECT_EQ("cimdelta-comparison", document["format"]);
    EXPECT_EQ(1, document["version"]);
}

TEST_F(FormatsTest, AGroupHasCountsAndSomeExamples)
{
    std::string before = System() + Class("Package", "", KeyProperty("Name") + Declaration("Version", "string"));
    std::string after = before;
    for (int i = 10; i < 40; ++i) {
        const std::string name = Value("Name", "p" + std::to_string(i));
        before += Instance("Package", name + Value("Version", "1." + std::to_string(i)));
        after += Instance("Package", name + Value("Version", i < 30 ? "2." + std::to_string(i) : "3"));
    }
    for (int i = 40; i < 60; ++i) {
        before += Instance("Package", Value("Name", "p" + std::to_string(i)) + Value("Version", "1"));
        after += i < 50 ? Instance("Package", Value("Name", "p" + std::to_string(i)) + Value("Version", "4")) : "";
    }
    Run({"compare", "-o", "json", Scratch("before.xml", Document(before)), Scratch("after.xml", Document(after))});
    const nlohmann::ordered_json groups = nlohmann::ordered_json::parse(fOut)["groups"];
    ASSERT_EQ(2u, groups.size());
    EXPECT_EQ("onlyInReference", groups[0]["kind"]);
    EXPECT_EQ(10, groups[0]["instances"]);
    EXPECT_EQ(8u, groups[0]["examples"].size());
    EXPECT_EQ("Package.Name=\"p57\"", groups[0]["examples"][7]);
    EXPECT_EQ("Version", groups[1]["property"]);
    EXPECT_EQ(40, groups[1]["instances"]);
    EXPECT_EQ(31, groups[1]["distinctChanges"]);
    ASSERT_EQ(8u, groups[1]["changes"].size());
    // The change that most instances have comes first, although eight others are there before it.
    EXPECT_EQ(10, groups[1]["changes"][0]["instances"]);
    EXPECT_EQ("4", groups[1]["changes"][0]["others"][0]["value"]);
    EXPECT_EQ("1", groups[1]["changes"][0]["reference"]["value"]);
    EXPECT_EQ(8u, groups[1]["changes"][0]["examples"].size());
    EXPECT_EQ(1, groups[1]["changes"][7]["instances"]);
}

TEST_F(FormatsTest, NotesOnTheSchemaAreInTheCoverage)
{
    Run({"compare", "--detail", "-o", "json", "web01.xml", "other-schema.xml"});
    const nlohmann::ordered_json notes = nlohmann::ordered_json::parse(fOut)["coverage"]["schema"];
    std::string text;
    for (const nlohmann::ordered_json& note : notes) {
        text += note.dump() + "\n";
    }
    EXPECT_EQ("{\"kind\":\"operatingSystemMade\",\"inventory\":\"other-schema\",\"asIn\":\"other-schema\",\"class\":\"KALMO_"
              "OperatingSystem\"}\n"
              "{\"kind\":\"classDeclared\",\"inventory\":\"other-schema\",\"asIn\":\"web01\",\"class\":\"INV_Disk\"}\n"
              "{\"kind\":\"classDeclared\",\"inventory\":\"other-schema\",\"asIn\":\"web01\",\"class\":\"INV_Element\"}\n"
              "{\"kind\":\"propertyDeclared\",\"inventory\":\"other-schema\",\"asIn\":\"web01\",\"class\":\"INV_Package\","
              "\"property\":\"Depends\"}\n"
              "{\"kind\":\"classRespelled\",\"inventory\":\"other-schema\",\"asIn\":\"web01\",\"class\":\"INV_Package\",\"before\":"
              "\"inv_package\"}\n"
              "{\"kind\":\"propertyRespelled\",\"inventory\":\"other-schema\",\"asIn\":\"web01\",\"class\":\"INV_Package\","
              "\"property\":\"Version\",\"before\":\"version\"}\n"
              "{\"kind\":\"classDeclared\",\"inventory\":\"other-schema\",\"asIn\":\"web01\",\"class\":\"INV_Service\"}\n"
              "{\"kind\":\"classDeclared\",\"inventory\":\"web01\",\"asIn\":\"other-schema\",\"class\":\"ACME_OperatingSystem\"}\n"
              "{\"kind\":\"classDeclared\",\"inventory\":\"web01\",\"asIn\":\"other-schema\",\"class\":\"CIM_OperatingSystem\"}\n"
              "{\"kind\":\"classDeclared\",\"inventory\":\"web01\",\"asIn\":\"other-schema\",\"class\":\"INV_Extra\"}\n"
              "{\"kind\":\"propertyDeclared\",\"inventory\":\"web01\",\"asIn\":\"other-schema\",\"class\":\"INV_Package\","
              "\"property\":\"Vendor\"}\n",
              text);
}

TEST_F(FormatsTest, CimXmlHoldsTheRecordsAndLoadsAgain)
{
    const std::string records =
        Scratch("records.xml", Result({"compare", "--detail", "-o", "cimxml", "web01.xml", "web02.xml", "web03.xml"}));
    EXPECT_EQ("KALMO_DeltaClass: 3 instances\n"
              "KALMO_Delta: 10 instances\n"
              "KALMO_DeltaClassAssocToDelta: 10 instances\n",
              Result({"show", records}));
    EXPECT_EQ("KALMO_Delta.DeltaID=4\n"
              "    Type: 4\n"
              "    InstanceName: \"INV_Package.Name=\\\"bash\\\"\"\n"
              "    Property: Version\n"
              "    NamespaceIndices: {1, 2}\n",
              Result({"query",
                      "SELECT Type, InstanceName, Property, NamespaceIndices FROM KALMO_Delta WHERE Property = 'Version' AND "
                      "InstanceName LIKE '%bash%'",
                      records}));
}

}  // namespace
}  // namespace NORVZEL20
