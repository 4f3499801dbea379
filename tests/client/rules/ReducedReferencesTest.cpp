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
    Run({"compare", "--detail", "--spec", rules, a, Scratch("b.xml", MountOf(Path("Nowhere", "Foo", "2")))});
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

/// As a comparison does it: instances do not match if a key that is a reference differs in an excluded key.
TEST_F(ReducedReferencesTest, AKeyThatIsAReferenceIsMatchedWhole)
{
    const auto inventory = [](const std::string& boot) {
        const std::string name = "<INSTANCENAME CLASSNAME=\"Host\"><KEYBINDING NAME=\"Name\"><KEYVALUE>n</KEYVALUE></KEYBINDING>"
                                 "<KEYBINDING NAME=\"Boot\"><KEYVALUE>" +
                                 boot + "</KEYVALUE></KEYBINDING></INSTANCENAME>";
        return Document(System() + Class("Host", "", KeyProperty("Name") + KeyProperty("Boot")) +
                        Class("Link", "", "<PROPERTY.REFERENCE NAME=\"A\">" + Qualifier("Key") + "</PROPERTY.REFERENCE>") +
                        Class("FreeLink", "Link", "<PROPERTY.REFERENCE NAME=\"B\"/>") + Instance("Link", Reference("A", name)));
    };
    const std::string a = Scratch("a.xml", inventory("1"));
    const std::string b = Scratch("b.xml", inventory("2"));
    const auto ask = [&](const std::string& keys) {
        const std::string rules =
            Scratch("rules", "<DifftoolSpec><class name='Link' default='include' excludekeys='" + keys + "'/></DifftoolSpec>");
        const std::string listing = Result({"check", rules, "--schema", a});
        const std::string explained = Shorten(Result({"explain", "Link.A", "--spec", rules, "--schema", a}), rules, "R");
        const std::string warning = listing.substr(std::min(listing.size(), listing.find("those in ")));
        Run({"compare", "--detail", "--spec", rules, a, b});
        return warning.substr(0, warning.find('\n') + 1) + explained + fOut.substr(0, fOut.find(" between "));
    };
    EXPECT_EQ("those in FreeLink.B are compared without key Boot and without their namespace\n"
              "Link.A: compared, by default, R:1 (element for class Link)\n"
              "2 differences",
              ask("Boot"));
    EXPECT_EQ("those in Link.A, FreeLink.A, FreeLink.B are compared without keys A, Boot and without their namespace\n"
              "Link.A: compared, by default, R:1 (element for class Link); references without keys A, Boot and without their "
              "namespace (excludekeys, R:1)\n"
              "No differences in what was compared",
              ask("A Boot"));
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
