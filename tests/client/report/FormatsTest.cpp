#include <nlohmann/json.hpp>

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
};

TEST_F(FormatsTest, NdjsonHasADocumentForEachDifferenceAndOneForTheCoverage)
{
    EXPECT_EQ(
        std::string(
            "{\"kind\":\"onlyInReference\",\"class\":\"INV_Disk\",\"instance\":\"INV_Disk.BootId=1,Device=\\\"sda\\\"\",\"keys\":"
            "{\"Device\":\"sda\",\"BootId\":1},"
            "\"inventories\":[\"web02\"]}\n"
            "{\"kind\":\"onlyInOthers\",\"class\":\"INV_Disk\",\"instance\":\"INV_Disk.BootId=7,Device=\\\"sda\\\"\",\"keys\":{"
            "\"Device\":\"sda\",\"BootId\":7},"
            "\"inventories\":[\"web02\"]}\n"
            "{\"kind\":\"changed\",\"class\":\"INV_Service\",\"instance\":\"INV_Service.Id=\\\"ssh\\\"\",\"keys\":{\"Id\":"
            "\"ssh\"},\"inventories\":[\"web03\"],"
            "\"property\":\"Caption\",\"reference\":{\"type\":\"string\",\"value\":\"Secure shell\"},"
            "\"others\":[{\"inventories\":[\"web03\"],\"type\":\"string\",\"value\":\"Secure\\nshell \u009b31m\"}]}\n"
            "{\"kind\":\"changed\",\"class\":\"INV_Service\",\"instance\":\"INV_Service.Id=\\\"ssh\\\"\",\"keys\":{\"Id\":"
            "\"ssh\"},\"inventories\":[\"web02\"],"
            "\"property\":\"Started\",\"reference\":{\"type\":\"boolean\",\"value\":true},"
            "\"others\":[{\"inventories\":[\"web02\"],\"type\":\"boolean\",\"value\":false}]}\n"
            "{\"kind\":\"coverage\",\"inventories\":[{\"label\":\"web01\",\"file\":\"web01.xml\",\"role\":\"reference\","
            "\"instancesCompared\":2,\"namespace\":\"root/cimv2\",\"namespaceFrom\":\"default\",\"inferredClasses\":[]},"
            "{\"label\":\"web02\",\"file\":\"web02.xml\",\"role\":\"other\",\"instancesCompared\":2,\"namespace\":\"root/cimv2\",\"namespaceFrom\":\"default\",\"inferredClasses\":[]},"
            "{\"label\":\"web03\",\"file\":\"web03.xml\",\"role\":\"other\",\"instancesCompared\":2,\"namespace\":\"root/cimv2\",\"namespaceFrom\":\"default\",\"inferredClasses\":[]}],"
            "\"summary\":{\"differences\":4,\"onlyInReference\":1,\"onlyInOthers\":1,\"changedValues\":2,\"changedInstances\":1,"
            "\"instancesOnlyInOthers\":1,\"everythingCompared\":false,\"nothingCompared\":false},"
            "\"classes\":[") +
            CoveredClass("INV_Disk", "compared", "1,1,1", "1,1,1") + "," +
            CoveredClass("INV_Package", "reachedByNoElement", "3,3,4", "0,0,0") + "," +
            CoveredClass("INV_Service", "compared", "1,1,1", "1,1,1") + "," +
            CoveredClass("KALMO_OperatingSystem", "reachedByNoElement", "1,1,1", "0,0,0") +
            "],\"classesWithoutInstances\":1,\"schema\":[],\"badValues\":[],\"systemNames\":[],\"hints\":[]}\n",
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
    nlohmann::ordered_json coverage = {
        {"kind", "coverage"}, {"inventories", document["inventories"]}, {"summary", document["summary"]}};
    coverage.update(document["coverage"]);
    EXPECT_EQ(lines, rebuilt + coverage.dump() + "\n");
    EXPECT_EQ("cimdelta-comparison", document["format"]);
    EXPECT_EQ(1, document["version"]);
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
