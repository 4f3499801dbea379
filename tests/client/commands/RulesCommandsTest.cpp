#include <algorithm>

#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

/// `check` and `explain`, with rules for the inventories in tests/client/data.
class RulesCommandsTest : public TClientFixture {};

TEST_F(RulesCommandsTest, CheckShowsElementsAndEffectiveRules)
{
    EXPECT_EQ("rules.xml: 2 elements, 0 warnings\n"
              "\n"
              "Elements:\n"
              "  line 3: class INV_Package, default include\n"
              "    line 5: exclude Size\n"
              "  line 8: class INV_Disk, default include, excludekeys BootId\n"
              "    line 10: exclude BootId\n"
              "\n"
              "Effective rules (classes with instances in web01.xml, or with an element):\n"
              "  KALMO_OperatingSystem: not compared\n"
              "  INV_Package: 4 of 5 properties compared, all but Size\n"
              "  INV_Disk: 3 of 4 properties compared, all but BootId; matched without BootId\n"
              "  INV_Service: not compared\n",
              Result({"check", "rules.xml", "--schema", "web01.xml"}));
    EXPECT_EQ(0, fStatus);
}

TEST_F(RulesCommandsTest, CheckWarnsOfWhatAnAuthorHardlyMeans)
{
    const std::string listing = Result({"check", "odd-rules.xml", "--schema", "web01.xml"});
    EXPECT_EQ(
        "Warnings:\n"
        "  odd-rules.xml:3: the element for class INV_Service is read before that of its ancestor INV_Element (line 4), whose "
        "default and lists replace its own; put it after that one\n"
        "  odd-rules.xml:9: class inv_disk is declared as INV_Disk; letter case counts in rules, so this element does not apply "
        "to that class\n"
        "  odd-rules.xml:10: excluded key Bootid of class INV_Disk is declared as BootId; letter case counts in rules, so it still "
        "counts as a key\n"
        "  odd-rules.xml:13: property size of class INV_Package is declared as Size; letter case counts in rules\n"
        "  odd-rules.xml:17: property Version of class INV_Package is already listed in this element; the first listing counts\n"
        "  odd-rules.xml:20: excludekeys of class INV_Package has no effect: the class has the keys of its first element, at line "
        "11; name them there\n"
        "  odd-rules.xml:21: this element for class INV_Package has no effect: the rules of the class were final after line 20; "
        "put what is meant there\n",
        listing.substr(listing.find("Warnings:")));
    EXPECT_EQ(0, fStatus);
}

TEST_F(RulesCommandsTest, CheckShowsRulesThatMatchedNothing)
{
    const std::string listing = Result({"check", "rules.xml", "--schema", "empty-classes.xml"});
    EXPECT_EQ("Rules that matched nothing:\n"
              "  rules.xml:3: class INV_Package has no instances, nor has any class below it\n"
              "  rules.xml:8: class INV_Disk has no instances, nor has any class below it\n",
              listing.substr(listing.find("Rules that matched")));
}

TEST_F(RulesCommandsTest, ASecondSchemaDeclaresWhatTheFirstLacks)
{
    const std::string rules = Scratch("extra", "<DifftoolSpec><class name='INV_Extra' default='include'/></DifftoolSpec>");
    EXPECT_EQ(2, (Run({"check", rules, "--schema", "web01.xml"}), fStatus));
    Run({"check", rules, "--schema", "web01.xml", "--schema", "other-schema.xml"});
    EXPECT_EQ(0, fStatus);
    EXPECT_NE(std::string::npos, fOut.find("  INV_Extra: 2 of 2 properties compared\n"));
}

TEST_F(RulesCommandsTest, ExplainNamesTheRuleThatDecides)
{
    const struct {
        const char* element;
        const char* explanation;
    } rows[] = {
        {"INV_Package.Version", "INV_Package.Version: compared, by default, rules.xml:3 (element for class INV_Package)\n"},
        {"INV_Package.Size",
         "INV_Package.Size: not compared, excluded by the list at rules.xml:5 (element for class INV_Package)\n"},
        {"inv_package.SIZE",
         "INV_Package.Size: not compared, excluded by the list at rules.xml:5 (element for class INV_Package)\n"},
        {"INV_Service.Id", "INV_Service.Id: not compared, by default, since no element is for this class or one above it\n"},
        {"INV_Disk", "INV_Disk: compared; default include, rules.xml:8 (element for class INV_Disk)\n"
                     "  matched without BootId (excludekeys, rules.xml:8)\n"
                     "  Device: compared, by default, rules.xml:8 (element for class INV_Disk)\n"
                     "  BootId: not compared, excluded by the list at rules.xml:10 (element for class INV_Disk)\n"
                     "  SizeMB: compared, by default, rules.xml:8 (element for class INV_Disk)\n"
                     "  Model: compared, by default, rules.xml:8 (element for class INV_Disk)\n"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.explanation, Result({"explain", row.element, "--spec", "rules.xml", "--schema", "web01.xml"}));
        EXPECT_EQ(0, fStatus);
    }
}

TEST_F(RulesCommandsTest, ExplainFollowsInheritanceAndOrder)
{
    EXPECT_EQ("INV_Service.Caption: compared, included by the list at odd-rules.xml:6 (element for class INV_Element)\n",
              Result({"explain", "INV_Service.Caption", "--spec", "odd-rules.xml", "--schema", "web01.xml"}));
    EXPECT_EQ("INV_Package.Version: not compared, excluded by the list at odd-rules.xml:14 (element for class INV_Package)\n",
              Result({"explain", "INV_Package.Version", "--spec", "odd-rules.xml", "--schema", "web01.xml"}));
}

TEST_F(RulesCommandsTest, ExplainFollowsAnIncludedNameInAnotherLetterCase)
{
    const std::string rules =
        Scratch("case", "<DifftoolSpec>\n<class name='INV_Package'>\n<includelist><value>version</value></includelist>\n"
                        "</class></DifftoolSpec>");
    EXPECT_EQ("INV_Package.Version: compared, included by the list at R:3 (element for class INV_Package)\n",
              Shorten(Result({"explain", "INV_Package.Version", "--spec", rules, "--schema", "web01.xml"}), rules, "R"));
    Run({"compare", "--detail", "--spec", rules, "web01.xml", "web02.xml"});
    EXPECT_NE(std::string::npos, fOut.find("    version: 5.1 -> 5.2\n")) << fOut;
}

TEST_F(RulesCommandsTest, ExplainKnowsWhatIsNeverCompared)
{
    const std::string rules = Scratch("os", "<DifftoolSpec><class name='KALMO_OperatingSystem' default='include'/></DifftoolSpec>");
    EXPECT_EQ("KALMO_OperatingSystem.DateTimeOfCollection: not compared, because the time of collection is never compared if the "
              "default is include\n",
              Result({"explain", "KALMO_OperatingSystem.DateTimeOfCollection", "--spec", rules, "--schema", "web01.xml"}));
}

/// The plug-in ignores start tags inside "value".
TEST_F(RulesCommandsTest, ElementsInAValueAreNotListed)
{
    const std::string rules =
        Scratch("nested", "<DifftoolSpec><class name='INV_Disk'><includelist><value>Model<class name='INV_Package'/></value>"
                          "</includelist></class></DifftoolSpec>");
    EXPECT_EQ("R: 1 element, 0 warnings\n"
              "\n"
              "Elements:\n"
              "  line 1: class INV_Disk, default exclude\n"
              "    line 1: include Model\n"
              "\n"
              "Effective rules (classes with instances in web01.xml, or with an element):\n"
              "  KALMO_OperatingSystem: not compared\n"
              "  INV_Package: not compared\n"
              "  INV_Disk: 1 of 4 properties compared, all but Device, BootId, SizeMB\n"
              "  INV_Service: not compared\n",
              Shorten(Result({"check", rules, "--schema", "web01.xml"}), rules, "R"));
    EXPECT_EQ("INV_Disk.Model: compared, included by the list at R:1 (element for class INV_Disk)\n",
              Shorten(Result({"explain", "INV_Disk.Model", "--spec", rules, "--schema", "web01.xml"}), rules, "R"));
    EXPECT_EQ("INV_Package.Version: not compared, by default, since no element is for this class or one above it\n",
              Result({"explain", "INV_Package.Version", "--spec", rules, "--schema", "web01.xml"}));
}

/// An ending value takes the text before the inner element; what follows belongs to nothing.
TEST_F(RulesCommandsTest, TextBehindAnElementInAValueIsIgnored)
{
    const std::string rules = Scratch("split", "<DifftoolSpec><class name='INV_Disk'><includelist><value>Mo<b>del</b>x</value>"
                                               "</includelist></class></DifftoolSpec>");
    EXPECT_EQ("INV_Disk.Model: compared, included by the list at R:1 (element for class INV_Disk)\n",
              Shorten(Result({"explain", "INV_Disk.Model", "--spec", rules, "--schema", "web01.xml"}), rules, "R"));
}

TEST_F(RulesCommandsTest, OrderCountsWithinALineToo)
{
    const std::string rules = Scratch("line", "<DifftoolSpec><class name='INV_Service' default='include'/>"
                                              "<class name='INV_Element' default='exclude'/></DifftoolSpec>");
    const std::string listing = Shorten(Result({"check", rules, "--schema", "web01.xml"}), rules, "R");
    EXPECT_EQ(
        "Warnings:\n"
        "  R:1: the element for class INV_Service is read before that of its ancestor INV_Element (line 1), whose default and "
        "lists replace its own; put it after that one\n",
        listing.substr(std::min(listing.size(), listing.find("Warnings:"))));
}

TEST_F(RulesCommandsTest, TheRootClassStandsForAllClasses)
{
    const std::string rules =
        Scratch("root", "<DifftoolSpec><class name='&lt;root&gt;' default='include' excludekeys='BootId'/></DifftoolSpec>");
    EXPECT_EQ("R: 1 element, 0 warnings\n"
              "\n"
              "Elements:\n"
              "  line 1: class <root>, default include, excludekeys BootId\n"
              "\n"
              "Effective rules (classes with instances in web01.xml, or with an element):\n"
              "  KALMO_OperatingSystem: 2 of 3 properties compared, all but DateTimeOfCollection\n"
              "  INV_Package: 5 of 5 properties compared\n"
              "  INV_Disk: 4 of 4 properties compared; matched without BootId\n"
              "  INV_Service: 3 of 3 properties compared\n",
              Shorten(Result({"check", rules, "--schema", "web01.xml"}), rules, "R"));
    EXPECT_EQ("INV_Disk.Model: compared, by default, R:1 (element for class <root>)\n",
              Shorten(Result({"explain", "INV_Disk.Model", "--spec", rules, "--schema", "web01.xml"}), rules, "R"));
}

TEST_F(RulesCommandsTest, AnExcludedKeyThatNoClassBelowHasGetsAWarning)
{
    const std::string rules =
        Scratch("below", "<DifftoolSpec><class name='&lt;root&gt;' default='include' excludekeys='BootId Nix'/></DifftoolSpec>");
    const std::string listing = Shorten(Result({"check", rules, "--schema", "web01.xml"}), rules, "R");
    EXPECT_EQ("Warnings:\n  R:1: excluded key Nix is not a key of class <root>\n",
              listing.substr(std::min(listing.size(), listing.find("Warnings:"))));
}

TEST_F(RulesCommandsTest, WithoutASchemaCheckReadsTheRulesAlone)
{
    const std::string rules = Scratch("alone", "<DifftoolSpec>\n<class name='Nix' default='include' excludekeys='Id'>\n"
                                               "<excludelist><value>Size</value></excludelist></class>\n</DifftoolSpec>");
    EXPECT_EQ("R: 1 element, 0 warnings\n"
              "\n"
              "Elements:\n"
              "  line 2: class Nix, default include, excludekeys Id\n"
              "    line 3: exclude Size\n"
              "\n"
              "Whether the classes and properties are declared was not checked, because there is no --schema.\n",
              Shorten(Result({"check", rules}), rules, "R"));
    EXPECT_EQ(0, fStatus);
    const std::string wrong = Scratch("wrong", "<DifftoolSpec><class name='Nix' default='includes'/></DifftoolSpec>");
    EXPECT_EQ("cimdelta: R:1: default \"includes\" is neither \"include\" nor \"exclude\"; letter case counts\n",
              Shorten(Complaint({"check", wrong}), wrong, "R"));
}

TEST_F(RulesCommandsTest, WithoutASchemaCheckRefusesWhatNoSchemaCanDeclare)
{
    for (const auto& [cls, property] : {std::pair<std::string, std::string>{"INV_Disk", ""}, {"&lt;root&gt;", "Name"}}) {
        const std::string rules = Scratch("never", "<DifftoolSpec><class name='" + cls + "'><includelist><value>" + property +
                                                       "</value></includelist></class></DifftoolSpec>");
        const std::string complaint = Complaint({"check", rules});
        EXPECT_NE(std::string::npos, complaint.find(" has no property \"" + property + "\"; the name counts")) << complaint;
    }
}

/// It would say of an element that matches nothing because it comes too late that the inventories are the reason.
TEST_F(RulesCommandsTest, AnElementWithoutEffectIsOnlyWarnedOf)
{
    const std::string element = "<class name='INV_Package' default='include'/>\n";
    const std::string rules = Scratch("late", "<DifftoolSpec>\n" + element + element + element + "</DifftoolSpec>");
    const std::string listing = Shorten(Result({"check", rules, "--schema", "empty-classes.xml"}), rules, "R");
    EXPECT_EQ("Rules that matched nothing:\n"
              "  R:2: class INV_Package has no instances, nor has any class below it\n"
              "  R:3: class INV_Package has no instances, nor has any class below it\n"
              "\n"
              "Warnings:\n"
              "  R:4: this element for class INV_Package has no effect: the rules of the class were final after line 3; put what "
              "is meant there\n",
              listing.substr(std::min(listing.size(), listing.find("Rules that matched nothing"))));
}

TEST_F(RulesCommandsTest, WithoutRulesExplainShowsThatEverythingIsCompared)
{
    EXPECT_EQ("INV_Package.Version: compared, by default, since everything is compared without --spec\n",
              Result({"explain", "INV_Package.Version", "--schema", "web01.xml"}));
    EXPECT_EQ("KALMO_OperatingSystem: compared; default include, since everything is compared without --spec\n"
              "  Name: compared, by default, since everything is compared without --spec\n"
              "  OSType: compared, by default, since everything is compared without --spec\n"
              "  DateTimeOfCollection: not compared, because the time of collection is never compared if the default is include\n",
              Result({"explain", "KALMO_OperatingSystem", "--schema", "web01.xml"}));
}

TEST_F(RulesCommandsTest, AStrictSchemaIsThatOfTheReferenceAlone)
{
    const std::string rules = Scratch("extra", "<DifftoolSpec><class name='INV_Extra' default='include'/></DifftoolSpec>");
    const std::vector<std::string> schemas{"--schema", "web01.xml", "--schema", "other-schema.xml"};
    for (std::vector<std::string> command : {std::vector<std::string>{"check", rules}, {"explain", "INV_Extra", "--spec", rules}}) {
        command.insert(command.end(), schemas.begin(), schemas.end());
        Run(command);
        EXPECT_EQ(0, fStatus) << fErr;
        command.push_back("--strict-schema");
        EXPECT_EQ("cimdelta: R:1: class INV_Extra is not declared in the reference; correct the name or remove the element\n",
                  Shorten(Complaint(command), rules, "R"));
    }
}

TEST_F(RulesCommandsTest, InstancesOfEveryInventoryCount)
{
    const std::string rules = Scratch("any", "<DifftoolSpec><class name='INV_Package' default='include'/></DifftoolSpec>");
    const std::string listing =
        Shorten(Result({"check", rules, "--schema", "empty-classes.xml", "--schema", "web01.xml"}), rules, "R");
    EXPECT_EQ(std::string::npos, listing.find("Rules that matched nothing")) << listing;
    EXPECT_NE(std::string::npos,
              listing.find("\nEffective rules (classes with instances in empty-classes.xml, web01.xml, or with an "
                           "element):\n"))
        << listing;
    EXPECT_NE(std::string::npos, listing.find("\n  INV_Service: not compared\n")) << listing;
}

/// What cimdelta makes itself is nothing that rules were written for.
TEST_F(RulesCommandsTest, AMadeOperatingSystemIsNoInstance)
{
    const std::string rules =
        Scratch("made", "<DifftoolSpec><class name='KALMO_OperatingSystem' default='include'/></DifftoolSpec>");
    Run({"check", rules, "--schema", "other-schema.xml"});
    EXPECT_NE(std::string::npos, fOut.find(":1: class KALMO_OperatingSystem has no instances, nor has any class below it\n"))
        << fOut;
    Run({"check", rules, "--schema", "other-schema.xml", "--schema", "web01.xml"});
    EXPECT_EQ(std::string::npos, fOut.find("has no instances")) << fOut;
}

TEST_F(RulesCommandsTest, TwoSpellingsInListsAreExplainedAsTheyAreCompared)
{
    const struct {
        const char* byDefault;
        const char* included;
        const char* excluded;
        const char* explanation;
    } rows[] = {
        {"exclude", "version", "Version",
         "INV_Package.Version: compared, included by the list at R:2 (element for class INV_Package)\n"},
        {"exclude", "Version", "version",
         "INV_Package.Version: compared, included by the list at R:2 (element for class INV_Package)\n"},
        {"include", "version", "Version",
         "INV_Package.Version: not compared, excluded by the list at R:3 (element for class INV_Package)\n"},
        {"include", "Version", "version",
         "INV_Package.Version: compared, included by the list at R:2 (element for class INV_Package)\n"},
    };
    for (const auto& row : rows) {
        const std::string rules =
            Scratch("spellings", std::string("<DifftoolSpec><class name='INV_Package' default='") + row.byDefault +
                                     "'>\n<includelist><value>" + row.included + "</value></includelist>\n<excludelist><value>" +
                                     row.excluded + "</value></excludelist></class></DifftoolSpec>");
        const std::string explanation =
            Shorten(Result({"explain", "INV_Package.Version", "--spec", rules, "--schema", "web01.xml"}), rules, "R");
        EXPECT_EQ(row.explanation, explanation);
        Run({"compare", "--detail", "--spec", rules, "web01.xml", "web02.xml"});
        EXPECT_EQ(explanation.find("not compared") == std::string::npos, fOut.find("ersion: 5.1 -> 5.2") != std::string::npos)
            << fOut;
    }
}

TEST_F(RulesCommandsTest, CompareSaysTheWarningsOfCheck)
{
    Run({"compare", "--detail", "--spec", "odd-rules.xml", "web01.xml", "web02.xml"});
    EXPECT_EQ(7, std::count(fErr.begin(), fErr.end(), '\n')) << fErr;
    EXPECT_EQ(0u, fErr.find("cimdelta: odd-rules.xml:3: warning: the element for class INV_Service is read before")) << fErr;
    Run({"compare", "--detail", "--spec", "rules.xml", "web01.xml", "web02.xml"});
    EXPECT_EQ("", fErr);
    Run({"compare", "--detail", "web01.xml", "web02.xml"});
    EXPECT_EQ("", fErr);
}

/// Before the inventory is loaded: this one cannot be.
TEST_F(RulesCommandsTest, WhatIsNoElementCannotBeExplained)
{
    const std::string damaged = Scratch("damaged.xml", "<CIM><");
    for (const std::string element : {"INV_Disk.", ".Size", "."}) {
        EXPECT_EQ("cimdelta: " + element + " is neither CLASS nor CLASS.PROPERTY\n",
                  Complaint({"explain", element, "--schema", damaged}));
    }
}

TEST_F(RulesCommandsTest, TheRootClassIsExplainedByItsElement)
{
    const auto explain = [this](const std::string& classes) {
        const std::string rules = Scratch("root", "<DifftoolSpec>" + classes + "</DifftoolSpec>");
        return Shorten(Result({"explain", "<root>", "--spec", rules, "--schema", "web01.xml"}), rules, "R");
    };
    EXPECT_EQ("<root>: has no properties and no instances; for the classes below: default include, R:1 (element for class <root>)\n"
              "  matched without BootId (excludekeys, R:1)\n",
              explain("<class name='&lt;root&gt;' default='include' excludekeys='BootId'/>"));
    EXPECT_EQ(
        "<root>: has no properties and no instances; for the classes below: default exclude, R:1 (element for class <root>)\n",
        explain("<class name='&lt;root&gt;'/>"));
    EXPECT_EQ("<root>: has no properties and no instances; no element is for it\n", explain("<class name='INV_Disk'/>"));
    EXPECT_EQ("<root>: has no properties and no instances\n", Result({"explain", "<root>", "--schema", "web01.xml"}));
    EXPECT_EQ("cimdelta: class <root> has no properties\n", Complaint({"explain", "<root>.Name", "--schema", "web01.xml"}));
}

TEST_F(RulesCommandsTest, WhatIsNotDeclaredCannotBeExplained)
{
    EXPECT_EQ("cimdelta: web01.xml: declares no class Nix; cimdelta show web01.xml lists those it declares\n",
              Complaint({"explain", "Nix", "--spec", "rules.xml", "--schema", "web01.xml"}));
    EXPECT_EQ("cimdelta: web01.xml: class INV_Disk has no property Nix; cimdelta explain INV_Disk --schema web01.xml lists those "
              "it has\n",
              Complaint({"explain", "INV_Disk.Nix", "--spec", "rules.xml", "--schema", "web01.xml"}));
}

}  // namespace
}  // namespace NORVZEL20
