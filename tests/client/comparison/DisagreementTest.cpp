#include "tests/client/TDocumentsFixture.h"

namespace NORVZEL20 {
namespace {

/// The reference lacks an instance that several others have: what differs among those is said too.
class DisagreementTest : public TDocumentsFixture {
  protected:
    static std::string User(const std::string& properties = std::string())
    {
        return Class("User", "",
                     KeyProperty("Name") + Declaration("Shell", "string") + Declaration("UID", "uint32") +
                         Declaration("DateTimeOfCollection", "datetime")) +
               (properties.empty() ? std::string() : Instance("User", Value("Name", "web") + properties));
    }

    static std::string WithUid(const std::string& uid) { return User(Value("UID", uid, "uint32")); }
};

TEST_F(DisagreementTest, ValuesThatDifferAmongTheOthersAreShown)
{
    EXPECT_EQ("User\n"
              "+ Name=\"web\"  (in b, c, d, e)\n"
              "    Shell: b, c, d: NULL / e: sh\n"
              "    UID: b, d: 1004 / c: 0 / e: NULL\n",
              Differences({User(), WithUid("1004"), WithUid("0"), WithUid("1004"), User(Value("Shell", "sh"))}));
    EXPECT_EQ("1 difference between a and b, c: 1 instance only elsewhere", Headline({User(), WithUid("1004"), WithUid("0")}));
}

TEST_F(DisagreementTest, JsonHasThemInAFieldOfTheirOwn)
{
    EXPECT_EQ("{\"kind\":\"onlyInOthers\",\"class\":\"User\",\"instance\":\"User.Name=\\\"web\\\"\",\"keys\":{\"Name\":\"web\"},"
              "\"inventories\":[\"b\",\"c\"],\"disagreements\":[{\"property\":\"UID\",\"others\":["
              "{\"inventories\":[\"b\"],\"type\":\"uint32\",\"value\":1004},"
              "{\"inventories\":[\"c\"],\"type\":\"uint32\",\"value\":0}]}],"
              "\"contents\":{\"UID\":{\"type\":\"uint32\",\"value\":1004}}}\n",
              Lines({User(), WithUid("1004"), WithUid("0")}));
}

TEST_F(DisagreementTest, AGroupedReportSaysThatThereAreSome)
{
    const auto findings = [this](const std::vector<std::string>& documents) {
        std::vector<std::string> arguments{"compare"};
        for (const std::string& contents : documents) {
            const std::string name(1, static_cast<char>('a' + arguments.size() - 1));
            arguments.push_back(name + "=" + Scratch(name + ".xml", Document(System() + contents)));
        }
        const std::string report = Result(arguments);
        const std::size_t begin = report.find("User  ");
        return report.substr(begin, report.find('\n', begin) - begin);
    };
    EXPECT_EQ("User  +1   only in b, c: web   (its values differ among them: --detail)",
              findings({User(), WithUid("1004"), WithUid("0")}));
    EXPECT_EQ("User  +1   only in b, c: web", findings({User(), WithUid("5"), WithUid("5")}));
}

TEST_F(DisagreementTest, EqualInstancesAreShownByTheirKeyAlone)
{
    EXPECT_EQ("User\n+ Name=\"web\"  (in b, c)\n", Differences({User(), WithUid("5"), WithUid("5")}));
    EXPECT_EQ("{\"kind\":\"onlyInOthers\",\"class\":\"User\",\"instance\":\"User.Name=\\\"web\\\"\",\"keys\":{\"Name\":\"web\"},"
              "\"inventories\":[\"b\",\"c\"],\"contents\":{\"UID\":{\"type\":\"uint32\",\"value\":5}}}\n",
              Lines({User(), WithUid("5"), WithUid("5")}));
}

TEST_F(DisagreementTest, PropertiesThatAreNotComparedAreNotShown)
{
    const auto collected = [](const std::string& time) {
        return User(Value("UID", time.substr(2, 2), "uint32") +
                    Value("DateTimeOfCollection", time + "0101000000.000000+000", "datetime"));
    };
    EXPECT_EQ("User\n+ Name=\"web\"  (in b, c)\n    UID: b: 24 / c: 25\n",
              Differences({User(), collected("2024"), collected("2025")}));
    Rules("<class name='User' default='include'><excludelist><value>UID</value></excludelist></class>");
    EXPECT_EQ("User\n+ Name=\"web\"  (in b, c)\n", Differences({User(), collected("2024"), collected("2025")}));
}

TEST_F(DisagreementTest, ValuesOfDifferentTypesAreShownWithTheirTypes)
{
    const auto disk = [](const std::string& type, bool exists) {
        return Class("Disk", "", KeyProperty("Id") + Declaration("Size", type)) +
               (exists ? Instance("Disk", Value("Id", "1") + Value("Size", "5", type)) : "");
    };
    EXPECT_EQ("Disk\n+ Id=\"1\"  (in b, c)\n    Size: b: uint32 5 / c: string 5\n",
              Differences({disk("uint32", false), disk("uint32", true), disk("string", true)}));
}

TEST_F(DisagreementTest, APropertyThatOneLacksUnderAStrictSchemaIsNull)
{
    const std::string lacking = Class("User", "", KeyProperty("Name")) + Instance("User", Value("Name", "web"));
    fOptions = {"--strict-schema"};
    EXPECT_EQ("User\n+ Name=\"web\"  (in b, c)\n    UID: b: 7 / c: NULL\n", Differences({User(), WithUid("7"), lacking}));
    const std::string lines = Lines({User(), WithUid("7"), lacking});
    EXPECT_NE(std::string::npos, lines.find("{\"inventories\":[\"c\"],\"type\":\"uint32\",\"value\":null}")) << lines;
}

}  // namespace
}  // namespace NORVZEL20
