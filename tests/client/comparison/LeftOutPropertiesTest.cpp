#include "tests/client/TDocumentsFixture.h"

namespace NORVZEL20 {
namespace {

/// A property that is not compared has a reason, which the report gives.
class LeftOutPropertiesTest : public TDocumentsFixture {
  protected:
    /// A disk with these further declarations and values.
    static std::string Disk(const std::string& declarations = std::string(), const std::string& values = std::string())
    {
        return Class("Disk", "", KeyProperty("Id") + declarations) + Instance("Disk", Value("Id", "sda") + values);
    }

    static std::string Collected(const std::string& time)
    {
        return Disk(Declaration("DateTimeOfCollection", "string"), Value("DateTimeOfCollection", time));
    }

    /// The lines of the text report and the JSON field that say what was left out of class Disk, and whether everything was
    /// compared.
    std::string LeftOut(const std::string& a, const std::string& b)
    {
        std::string said;
        const std::string report = Compare({a, b});
        for (std::size_t begin = 0; begin < report.size(); begin = report.find('\n', begin) + 1) {
            if (report.compare(begin, 10, "Properties") == 0 || report.compare(begin, 8, "Property") == 0) {
                said += report.substr(begin, report.find('\n', begin) + 1 - begin);
            }
        }
        const std::string json = Compare({a, b}, {"-o", "ndjson"});
        const std::string ofDisk = json.substr(json.find("{\"class\":\"Disk\","));
        const std::string reasons = ofDisk.substr(0, ofDisk.find("]}") + 1);
        return said + reasons.substr(reasons.find("\"leftOutReasons\":")) +
               (json.find("\"everythingCompared\":true") == std::string::npos ? "" : " and everything compared");
    }
};

TEST_F(LeftOutPropertiesTest, TheReasonIsGiven)
{
    const std::string sized = Disk(Declaration("Size", "string") + Declaration("Model", "string"));
    const struct {
        const char* what;
        std::string rules;
        std::string a;
        std::string b;
        std::string said;
    } rows[] = {
        {"an exclude list", "<class name='Disk' default='include'><excludelist><value>Size</value></excludelist></class>", sized,
         sized,
         "Properties of Disk not compared, because the rules leave them out: Size.\n"
         "\"leftOutReasons\":[{\"property\":\"Size\",\"reason\":\"excludedByRules\"}]"},
        {"a key that is not listed", "<class name='Disk' default='exclude'><includelist><value>Size</value></includelist></class>",
         sized, sized,
         "Properties of Disk not compared, because the rules leave them out: Model.\n"
         "Properties of Disk used as keys, not compared as properties: Id.\n"
         "\"leftOutReasons\":[{\"property\":\"Id\",\"reason\":\"usedAsKey\"},{\"property\":\"Model\",\"reason\":"
         "\"excludedByRules\"}]"},
        {"a key that is excluded as a key, too",
         "<class name='Disk' default='exclude' excludekeys='Id'><includelist><value>Size</value></includelist></class>", sized,
         sized,
         "Properties of Disk not compared, because the rules leave them out: Id, Model.\n"
         "\"leftOutReasons\":[{\"property\":\"Id\",\"reason\":\"excludedByRules\"},{\"property\":\"Model\",\"reason\":"
         "\"excludedByRules\"}]"},
        {"the time of collection", "<class name='Disk' default='include'/>", Collected("x"), Collected("y"),
         "Property of Disk not compared, because it is the time of collection: DateTimeOfCollection.\n"
         "\"leftOutReasons\":[{\"property\":\"DateTimeOfCollection\",\"reason\":\"timeOfCollection\"}]"},
        {"a time of collection that the rules exclude by name",
         "<class name='Disk' default='include'><excludelist><value>DateTimeOfCollection</value></excludelist></class>",
         Collected("x"), Collected("y"),
         "Properties of Disk not compared, because the rules leave them out: DateTimeOfCollection.\n"
         "\"leftOutReasons\":[{\"property\":\"DateTimeOfCollection\",\"reason\":\"excludedByRules\"}]"},
    };
    for (const auto& row : rows) {
        Rules(row.rules + "<class name='KALMO_OperatingSystem' default='include'/>");
        EXPECT_EQ(row.said, LeftOut(row.a, row.b)) << row.what;
    }
}

TEST_F(LeftOutPropertiesTest, WithoutRulesToo)
{
    const std::string bare = Disk();
    const std::string sized = Disk(Declaration("Size", "string"), Value("Size", "5"));
    EXPECT_EQ("\"leftOutReasons\":[] and everything compared", LeftOut(bare, bare));
    const std::string timed = Class("Disk", "", KeyProperty("Id") + KeyProperty("DateTimeOfCollection")) +
                              Instance("Disk", Value("Id", "sda") + Value("DateTimeOfCollection", "x"));
    EXPECT_EQ("Properties of Disk used as keys, not compared as properties: DateTimeOfCollection.\n"
              "\"leftOutReasons\":[{\"property\":\"DateTimeOfCollection\",\"reason\":\"usedAsKey\"}]",
              LeftOut(timed, timed));
    fOptions = {"--strict-schema"};
    EXPECT_EQ("Properties of Disk not compared, because a does not declare them: Size.\n"
              "\"leftOutReasons\":[{\"property\":\"Size\",\"reason\":\"notDeclared\"}]",
              LeftOut(bare, sized));
}

}  // namespace
}  // namespace NORVZEL20
