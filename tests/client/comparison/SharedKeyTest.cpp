#include <nlohmann/json.hpp>

#include "tests/client/TDocumentsFixture.h"

namespace NORVZEL20 {
namespace {

/// Rules that exclude keys make several instances of an inventory share one: the report says which of them it speaks of.
class SharedKeyTest : public TDocumentsFixture {
  protected:
    void SetUp() override
    {
        TDocumentsFixture::SetUp();
        Rules("<class name='Disk' default='include' excludekeys='Boot'><excludelist><value>Boot</value></excludelist></class>");
    }

    static std::string Declared()
    {
        return Class("Disk", "",
                     KeyProperty("Id") + KeyProperty("Boot") + Declaration("Size", "uint32") +
                         "<PROPERTY.ARRAY NAME=\"Tags\" TYPE=\"string\"/><PROPERTY.REFERENCE NAME=\"Twin\"/>");
    }

    static std::string Disk(const std::string& boot, const std::string& properties)
    {
        return Instance("Disk", Value("Id", "sda") + Value("Boot", boot) + properties);
    }

    static std::string OfSize(const std::string& boot, const std::string& size)
    {
        return Disk(boot, Value("Size", size, "uint32"));
    }

    static std::string Tagged(const std::string& boot, const std::string& first, const std::string& second)
    {
        return Disk(boot, "<PROPERTY.ARRAY NAME=\"Tags\" TYPE=\"string\"><VALUE.ARRAY><VALUE>" + first + "</VALUE><VALUE>" +
                              second + "</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>");
    }

    static std::string Twin(const std::string& boot, const std::string& id, const std::string& bootOfTwin)
    {
        const auto binding = [](const std::string& name, const std::string& value) {
            return "<KEYBINDING NAME=\"" + name + "\"><KEYVALUE>" + value + "</KEYVALUE></KEYBINDING>";
        };
        return Disk(boot, "<PROPERTY.REFERENCE NAME=\"Twin\"><VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"Disk\">" +
                              binding("Id", id) + binding("Boot", bootOfTwin) +
                              "</INSTANCENAME></VALUE.REFERENCE></PROPERTY.REFERENCE>");
    }
};

TEST_F(SharedKeyTest, AChangeSaysHowManyOfTheInstancesHaveIt)
{
    EXPECT_EQ("Disk\n~ Id=\"sda\"\n    Size: 5 -> 9 (one of 2 instances of b with this key)\n",
              Differences({Declared() + OfSize("1", "5"), Declared() + OfSize("2", "9") + OfSize("3", "5")}));
    EXPECT_EQ("Disk\n"
              "~ Id=\"sda\"\n"
              "    Size: 5 -> b, c: 9 (2 of 3 instances of b with this key) / b: 7 (one of 3 instances of b with this key)\n",
              Differences({Declared() + OfSize("1", "5"), Declared() + OfSize("2", "9") + OfSize("3", "7") + OfSize("4", "9"),
                           Declared() + OfSize("2", "9")}));
}

/// With two inventories the first of them overwrites the reference's value, so the second one seems equal to the engine.
TEST_F(SharedKeyTest, AValueThatTheReferenceTookOverStillDiffers)
{
    EXPECT_EQ("Disk\n~ Id=\"sda\"\n    Size: 5 -> 9 (2 of 2 instances of b with this key)\n",
              Differences({Declared() + OfSize("1", "5"), Declared() + OfSize("2", "9") + OfSize("3", "9")}));
}

TEST_F(SharedKeyTest, TheReferencesInstanceIsTheFirst)
{
    EXPECT_EQ("Disk\n~ Id=\"sda\"  (the first of 2 instances of a with this key)\n    Size: 5 -> 9\n",
              Differences({Declared() + OfSize("1", "5") + OfSize("2", "6"), Declared() + OfSize("3", "9")}));
    EXPECT_EQ("Disk\n- Id=\"sda\"  (the first of 2 instances of a with this key; path: root/cimv2:Disk.Boot=\"1\",Id=\"sda\")\n",
              Differences({Declared() + OfSize("1", "5") + OfSize("2", "6"), Declared()}));
    EXPECT_EQ(
        "{\"kind\":\"onlyInReference\",\"class\":\"Disk\",\"instance\":\"Disk.Id=\\\"sda\\\"\",\"keys\":{\"Id\":\"sda\"},"
        "\"inventories\":[\"b\"],\"sharing\":[{\"inventory\":\"a\",\"instances\":2}],"
        "\"path\":\"root/cimv2:Disk.Boot=\\\"1\\\",Id=\\\"sda\\\"\",\"contents\":{\"Size\":{\"type\":\"uint32\",\"value\":5}}}\n",
        Lines({Declared() + OfSize("1", "5") + OfSize("2", "6"), Declared()}));
}

TEST_F(SharedKeyTest, OfSeveralInventoriesAPathStandsBehindThoseThatLackIt)
{
    EXPECT_EQ("Disk\n- Id=\"sda\"  (not in b; path: root/cimv2:Disk.Boot=\"1\",Id=\"sda\")\n",
              Differences({Declared() + OfSize("1", "5"), Declared(), Declared() + OfSize("2", "5")}));
}

TEST_F(SharedKeyTest, OnlyAClassWhoseRulesExcludeKeysHasPaths)
{
    Rules("<class name='Disk' default='include' excludekeys='Boot'><excludelist><value>Boot</value></excludelist></class>"
          "<class name='Tape' default='include'/>");
    const std::string tapes = Class("Tape", "", KeyProperty("Id"));
    const std::vector<std::string> documents = {Declared() + OfSize("1", "5") + tapes + Instance("Tape", Value("Id", "t")),
                                                Declared() + tapes};
    EXPECT_EQ("Disk\n- Id=\"sda\"  (path: root/cimv2:Disk.Boot=\"1\",Id=\"sda\")\n\nTape\n- Id=\"t\"\n", Differences(documents));
    const std::string records = Compare(documents, {"-o", "cimxml"});
    EXPECT_NE(std::string::npos, records.find("<VALUE>Tape.Id=\"t\"</VALUE>")) << records;
    EXPECT_NE(std::string::npos, records.find("<VALUE>root/cimv2:Disk.Boot=\"1\",Id=\"sda\"</VALUE>")) << records;
}

TEST_F(SharedKeyTest, AGroupNamesOnlyInventoriesWithSharedKeys)
{
    const std::string report =
        Compare({Declared() + OfSize("1", "5"), Declared() + OfSize("2", "9") + OfSize("3", "9"), Declared() + OfSize("4", "9")},
                {"-o", "json"});
    const nlohmann::ordered_json document = nlohmann::ordered_json::parse(report);
    EXPECT_EQ(R"([{"inventory":"b","instances":2}])", document["differences"][0]["others"][0]["sharing"].dump());
    EXPECT_EQ(document["differences"][0]["others"], document["groups"][0]["changes"][0]["others"]);
}

TEST_F(SharedKeyTest, InstancesThatTheReferenceLacksAreAllNamed)
{
    const std::string two = Declared() + OfSize("1", "5") + OfSize("2", "6");
    EXPECT_EQ("1 difference between a and b: 1 key only in b", Headline({Declared(), two}));
    EXPECT_EQ("Disk\n"
              "+ Id=\"sda\"  (2 instances of b with this key)\n"
              "    Size: 5 (one of 2 with this key) / 6 (one of 2 with this key)\n",
              Differences({Declared(), two}));
    EXPECT_EQ("1 difference between a and b, c: 1 key only elsewhere", Headline({Declared(), two, Declared() + OfSize("3", "6")}));
    EXPECT_EQ("Disk\n"
              "+ Id=\"sda\"  (in b, c; 2 instances of b with this key)\n"
              "    Size: b: 5 (one of 2 of b with this key) / b, c: 6 (one of 2 of b with this key)\n",
              Differences({Declared(), two, Declared() + OfSize("3", "6")}));
    EXPECT_EQ(
        "{\"kind\":\"onlyInOthers\",\"class\":\"Disk\",\"instance\":\"Disk.Id=\\\"sda\\\"\",\"keys\":{\"Id\":\"sda\"},"
        "\"inventories\":[\"b\"],\"sharing\":[{\"inventory\":\"b\",\"instances\":2}],\"disagreements\":[{\"property\":\"Size\","
        "\"others\":[{\"inventories\":[\"b\"],\"type\":\"uint32\",\"value\":5,\"sharing\":[{\"inventory\":\"b\",\"instances\":1}]},"
        "{\"inventories\":[\"b\"],\"type\":\"uint32\",\"value\":6,\"sharing\":[{\"inventory\":\"b\",\"instances\":1}]}]}],"
        "\"contents\":{\"Size\":{\"type\":\"uint32\",\"value\":5}}}\n",
        Lines({Declared(), two}));
}

TEST_F(SharedKeyTest, TheSummaryCountsWhatIsListed)
{
    const auto disks = [](std::size_t sharing, const std::string& alone) {
        std::string document = Declared();
        for (std::size_t boot = 0; boot < sharing; ++boot) {
            document += OfSize(std::to_string(boot), "5");
        }
        return document + (alone.empty() ? "" : Instance("Disk", Value("Id", alone) + Value("Boot", "1")));
    };
    const struct {
        std::vector<std::string> documents;
        std::string headline;
        std::string counts;
    } rows[] = {
        {{disks(0, "x"), disks(2, "y")},
         "3 differences between a and b: 1 instance only in a, 2 keys only in b",
         "\"differences\":3,\"onlyInReference\":1,\"onlyInOthers\":2,\"changedValues\":0,\"changedInstances\":0,"
         "\"instancesOnlyInOthers\":3,"},
        {{disks(0, ""), disks(1, ""), disks(1, "y")},
         "2 differences between a and b, c: 2 instances only elsewhere",
         "\"differences\":2,\"onlyInReference\":0,\"onlyInOthers\":2,\"changedValues\":0,\"changedInstances\":0,"
         "\"instancesOnlyInOthers\":2,"},
        {{disks(0, ""), disks(3, ""), disks(2, "y")},
         "2 differences between a and b, c: 2 keys only elsewhere",
         "\"differences\":2,\"onlyInReference\":0,\"onlyInOthers\":2,\"changedValues\":0,\"changedInstances\":0,"
         "\"instancesOnlyInOthers\":4,"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.headline, Headline(row.documents));
        EXPECT_NE(std::string::npos, Compare(row.documents, {"-o", "ndjson"}).find(row.counts)) << fOut;
    }
}

TEST_F(SharedKeyTest, WhatTheEngineTakesForEqualIsNotListed)
{
    EXPECT_EQ("Disk\n~ Id=\"sda\"\n    Tags: {\"x\", \"y\"} -> {\"x\", \"z\"} (one of 2 instances of b with this key)\n",
              Differences({Declared() + Tagged("1", "x", "y"), Declared() + Tagged("2", "y", "x") + Tagged("3", "x", "z")}));
    EXPECT_EQ("Disk\n"
              "~ Id=\"sda\"\n"
              "    Twin: Disk.Boot=\"1\",Id=\"sdb\" -> Disk.Boot=\"1\",Id=\"sdc\" (one of 2 instances of b with this key)\n",
              Differences({Declared() + Twin("1", "sdb", "1"), Declared() + Twin("2", "sdb", "2") + Twin("3", "sdc", "1")}));
}

TEST_F(SharedKeyTest, WhatTheEngineTakesForEqualStandsTogether)
{
    EXPECT_EQ(
        "Disk\n~ Id=\"sda\"\n    Tags: {\"x\", \"y\"} -> b, c: {\"x\", \"z\"}\n",
        Differences({Declared() + Tagged("1", "x", "y"), Declared() + Tagged("2", "x", "z"), Declared() + Tagged("2", "z", "x")}));
    EXPECT_EQ("Disk\n+ Id=\"sda\"  (in b, c)\n",
              Differences({Declared(), Declared() + Twin("1", "sdb", "1"), Declared() + Twin("1", "sdb", "2")}));
}

TEST_F(SharedKeyTest, IfEveryKeyIsExcludedTheFirstInstanceStandsForAll)
{
    Rules("<class name='Disk' default='exclude' excludekeys='Boot Id'><includelist><value>Size</value></includelist></class>");
    EXPECT_EQ("Disk\n"
              "~ (any instance of the class; the rules exclude every key)  (the first of 2 instances of a with this key)\n"
              "    Size: 5 -> 9\n",
              Differences({Declared() + OfSize("1", "5") + OfSize("2", "9"), Declared() + OfSize("1", "9")}));
}

/// A value must not be mistaken for a remark of the report.
TEST_F(SharedKeyTest, AValueThatLooksLikeARemarkIsQuoted)
{
    const auto model = [](const std::string& value) {
        return Class("Tape", "", KeyProperty("Id") + Declaration("Model", "string")) +
               Instance("Tape", Value("Id", "1") + Value("Model", value));
    };
    fOptions.clear();
    EXPECT_EQ("Tape\n~ Id=\"1\"\n    Model: A -> \"B (one of 2 instances of b with this key)\"\n",
              Differences({model("A"), model("B (one of 2 instances of b with this key)")}));
}

TEST_F(SharedKeyTest, AClassWithoutKeysHasOneInstance)
{
    const auto clock = [](const std::string& zone) {
        return Class("Clock", "", Declaration("Zone", "string")) + (zone.empty() ? "" : Instance("Clock", Value("Zone", zone)));
    };
    fOptions.clear();
    EXPECT_EQ("Clock\n~ (the only instance; the class has no keys)\n    Zone: UTC -> CET\n",
              Differences({clock("UTC"), clock("CET")}));
    EXPECT_EQ("Clock\n- (the only instance; the class has no keys)\n", Differences({clock("UTC"), clock("")}));
}

TEST_F(SharedKeyTest, ManyReferencesAreGroupedWithoutTheExcludedKeys)
{
    std::string twins;
    std::string groups;
    for (int i = 0; i < 24; ++i) {
        twins += Twin(std::to_string(i), "sd" + std::to_string(i % 12), std::to_string(i));
    }
    for (int i = 0; i < 12; ++i) {
        groups += (i == 0 ? "" : " / ") + std::string("Disk.Boot=\"") + std::to_string(i) + "\",Id=\"sd" + std::to_string(i) +
                  "\" (2 of 24 instances of b with this key)";
    }
    EXPECT_EQ("Disk\n~ Id=\"sda\"\n    Twin: Disk.Boot=\"1\",Id=\"sdx\" -> " + groups + "\n",
              Differences({Declared() + Twin("1", "sdx", "1"), Declared() + twins}));
}

}  // namespace
}  // namespace NORVZEL20
