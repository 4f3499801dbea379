#include "tests/client/TMountFixture.h"

namespace NORVZEL20 {
namespace {

/// Excluded keys also change how references are compared; `check` and `explain` say so before a comparison does.
class ReducedReferencesTest : public TMountFixture {
  protected:
    /// Runs the command with these rules, which it calls R, for an inventory with a mount.
    std::string Ask(const std::string& command, const std::string& element, const std::string& classes)
    {
        const std::string rules = Scratch("rules", "<DifftoolSpec>" + classes + "</DifftoolSpec>");
        const std::string inventory = Scratch("mounts.xml", Mounts("sda"));
        return Shorten(Result(command == "check"
                                  ? std::vector<std::string>{command, rules, "--schema", inventory}
                                  : std::vector<std::string>{command, element, "--spec", rules, "--schema", inventory}),
                       rules, "R");
    }

    /// The warnings of `check`; empty if there are none.
    std::string Warnings(const std::string& classes)
    {
        const std::string listing = Ask("check", "", classes);
        return listing.substr(std::min(listing.size(), listing.find("Warnings:\n")));
    }
};

TEST_F(ReducedReferencesTest, CheckWarnsOfThem)
{
    EXPECT_EQ("Warnings:\n"
              "  R:1: excludekeys also applies to references: those in NetworkMount.Dev are compared without key Point and without "
              "their namespace\n",
              Warnings("<class name='NetworkMount' excludekeys='Point'><includelist><value>Dev</value></includelist></class>"));
    EXPECT_EQ(
        "Warnings:\n"
        "  R:1: excludekeys also applies to references: those in Mount.Dev, NetworkMount.Dev, NetworkMount.Server are compared "
        "without keys Point, Name and without their namespace\n",
        Warnings("<class name='&lt;root&gt;' default='include' excludekeys='Point Name'/>"));
}

/// As a comparison says it, which finds no such key in any reference.
TEST_F(ReducedReferencesTest, AKeyThatNoReferenceCanHaveIsNotNamed)
{
    const std::string rules = "<class name='Mount' default='include' excludekeys='Foo'/>";
    EXPECT_EQ("Mount.Dev: compared, by default, R:1 (element for class Mount); references without their namespace (excludekeys, "
              "R:1)\n",
              Ask("explain", "Mount.Dev", rules));
    const std::string listing = Ask("check", "", rules);
    EXPECT_NE(std::string::npos, listing.find("  Mount: 2 of 2 properties compared; references compared without their namespace\n"))
        << listing;
    EXPECT_NE(std::string::npos, listing.find("those in Mount.Dev, NetworkMount.Dev, NetworkMount.Server are compared without "
                                              "their namespace\n"))
        << listing;
}

TEST_F(ReducedReferencesTest, AKeyOfAnUndeclaredClassIsNamedIfAReferenceHasIt)
{
    const std::string rules =
        Scratch("rules", "<DifftoolSpec><class name='Mount' default='include' excludekeys='Foo Foo Bar'/></DifftoolSpec>");
    const std::string a = Scratch("a.xml", MountOf(Path("Nowhere", "Foo", "1")));
    const std::string words = "compared without key Foo and without their namespace";
    EXPECT_NE(std::string::npos, Result({"check", rules, "--schema", a}).find("; references " + words + "\n")) << fOut;
    EXPECT_NE(std::string::npos, fOut.find("NetworkMount.Server are " + words + "\n")) << fOut;
    Run({"compare", "--spec", rules, a, Scratch("b.xml", MountOf(Path("Nowhere", "Foo", "2")))});
    EXPECT_NE(std::string::npos, fOut.find("References of Mount were " + words + ".\n")) << fOut;
}

TEST_F(ReducedReferencesTest, CheckIsSilentIfNoReferenceIsCompared)
{
    EXPECT_EQ("", Warnings("<class name='Mount' default='include'/>"));
    EXPECT_EQ("", Warnings("<class name='Disk' default='include' excludekeys='Name'/>"));
    EXPECT_EQ("", Warnings("<class name='Mount' excludekeys='Point'><includelist><value>Point</value></includelist></class>"));
    EXPECT_EQ("", Warnings("<class name='Mount' default='include' excludekeys='Point'><excludelist><value>Dev</value></excludelist>"
                           "</class><class name='NetworkMount' default='exclude'/>"));
}

TEST_F(ReducedReferencesTest, CheckShowsThemInTheEffectiveRules)
{
    const std::string listing = Ask("check", "", "<class name='Mount' default='include' excludekeys='Point'/>");
    EXPECT_NE(std::string::npos, listing.find("  Mount: 2 of 2 properties compared; matched without Point; references compared "
                                              "without key Point and without their namespace\n"))
        << listing;
}

TEST_F(ReducedReferencesTest, ExplainSaysItOfTheProperty)
{
    const std::string rules = "<class name='Mount' default='include' excludekeys='Point'/>";
    EXPECT_EQ("Mount.Dev: compared, by default, R:1 (element for class Mount); references without key Point and without their "
              "namespace (excludekeys, R:1)\n",
              Ask("explain", "Mount.Dev", rules));
    EXPECT_EQ("Mount.Point: compared, by default, R:1 (element for class Mount)\n", Ask("explain", "Mount.Point", rules));
    EXPECT_NE(std::string::npos, Ask("explain", "Mount", rules).find("references without key Point and without their namespace"));
}

}  // namespace
}  // namespace NORVZEL20
