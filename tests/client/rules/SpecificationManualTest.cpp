// What docs/specification-file.md promises, sentence by sentence, with the plug-in itself.

#include <filesystem>
#include <regex>

#include "tests/client/TPairFixture.h"

namespace NORVZEL20 {
namespace {

/// Compares two inventories in which every value differs: an INV_Element (Id) above INV_Package, INV_Disk (with BootId as a second
/// key) and, below that, INV_SolidStateDisk; INV_Rack stands alone.
class SpecificationManualTest : public TPairFixture {
  protected:
    /// What differs under these rules, without the report's head and end.
    std::string Differences(const std::string& classes, const std::vector<std::string>& options = {})
    {
        std::vector<std::string> all{"--spec", Scratch("rules", "<DifftoolSpec>" + classes + "</DifftoolSpec>")};
        all.insert(all.end(), options.begin(), options.end());
        const std::string report = Compare(Inventory("1"), Inventory("2"), all);
        const std::size_t begin = report.find("\n\n");
        const std::size_t end = report.find("\n\nCompared: ");
        return begin == std::string::npos || end == std::string::npos || begin == end
                   ? "none\n"
                   : report.substr(begin + 2, end + 1 - begin - 2);
    }

    /// The names of the properties that are compared, class by class.
    std::string Compared(const std::string& classes)
    {
        std::string names;
        const std::regex changed("(INV_[A-Za-z]+)\n|    ([A-Za-z]+): [^\n]*\n|[^\n]*\n");
        const std::string differences = Differences(classes);
        for (std::sregex_iterator at(differences.begin(), differences.end(), changed), end; at != end; ++at) {
            names += (*at)[1].matched ? (names.empty() ? "" : "; ") + (*at)[1].str() + ":" : "";
            names += (*at)[2].matched ? " " + (*at)[2].str() : "";
        }
        return names;
    }

    static std::string Thing(const std::string& cls, const std::string& value, const std::string& more = std::string())
    {
        return Instance(cls, Value("Id", "x") + Value("Size", value) + Value("Model", value) + more);
    }

    /// An inventory whose values are all `value`, except for the keys Id and, if it is given, `bootId`.
    static std::string Inventory(const std::string& value, const std::string& bootId = "7")
    {
        const std::string boot = Value("BootId", bootId);
        return Document(System() +
                        Class("INV_Element", "",
                              KeyProperty("Id") + Declaration("Size", "string") + Declaration("Model", "string") +
                                  Declaration("DateTimeOfCollection", "string")) +
                        Class("INV_Package", "INV_Element", "") + Class("INV_Disk", "INV_Element", KeyProperty("BootId")) +
                        Class("INV_SolidStateDisk", "INV_Disk", "") +
                        Class("INV_Rack", "", KeyProperty("Id") + Declaration("Size", "string") + Declaration("Model", "string")) +
                        Thing("INV_Element", value, Value("DateTimeOfCollection", value)) + Thing("INV_Package", value) +
                        Thing("INV_Disk", value, boot) + Thing("INV_SolidStateDisk", value, boot) + Thing("INV_Rack", value));
    }

    static std::string Element(const std::string& name, const std::string& attributes, const std::string& included = std::string(),
                               const std::string& excluded = std::string())
    {
        const auto list = [](const std::string& kind, const std::string& property) {
            return property.empty() ? "" : "<" + kind + "><value>" + property + "</value></" + kind + ">";
        };
        return "<class name='" + name + "' " + attributes + ">" + list("includelist", included) + list("excludelist", excluded) +
               "</class>";
    }
};

const char kInclude[] = "default='include'";
const char kExclude[] = "default='exclude'";
const char kRoot[] = "&lt;root&gt;";

TEST_F(SpecificationManualTest, RulesReachAllClassesBelow)
{
    EXPECT_EQ("INV_Disk: Model Size; INV_SolidStateDisk: Model Size", Compared(Element("INV_Disk", kInclude)));
    EXPECT_EQ("INV_Rack: Model Size", Compared(Element("INV_Rack", kInclude)));
    EXPECT_EQ("", Compared(""));
}

TEST_F(SpecificationManualTest, TheRootClassIsTheShortestRuleForEverything)
{
    const std::string everything = "INV_Disk: Model Size; INV_Element: Model Size; INV_Package: Model Size; INV_Rack: Model Size; "
                                   "INV_SolidStateDisk: Model Size";
    EXPECT_EQ(everything, Compared(Element(kRoot, kInclude)));
    const std::string all = Compare(Inventory("1"), Inventory("2"));
    EXPECT_EQ(all,
              Compare(Inventory("1"), Inventory("2"),
                      {"--spec", Scratch("root", "<DifftoolSpec><class name='&lt;root&gt;' default='include'/></DifftoolSpec>")}));
    // Exceptions follow it.
    EXPECT_EQ("INV_Element: Model Size; INV_Package: Model Size; INV_Rack: Model",
              Compared(Element(kRoot, kInclude) + Element("INV_Disk", kExclude) + Element("INV_Rack", kInclude, "", "Size")));
    EXPECT_EQ("", Compared(Element(kRoot, kInclude, "Size")));
    EXPECT_EQ(2, fStatus);
}

TEST_F(SpecificationManualTest, ListsDecideBeforeTheDefault)
{
    EXPECT_EQ("INV_Rack: Size", Compared(Element("INV_Rack", kExclude, "Size")));
    EXPECT_EQ("INV_Rack: Size", Compared(Element("INV_Rack", "", "Size")));
    EXPECT_EQ("INV_Rack: Model", Compared(Element("INV_Rack", kInclude, "", "Size")));
    // The first listing counts.
    EXPECT_EQ("INV_Rack: Model Size", Compared(Element("INV_Rack", kInclude, "Size", "Size")));
    EXPECT_EQ("INV_Rack: Model", Compared("<class name='INV_Rack' default='include'><excludelist><value>Size</value></excludelist>"
                                          "<includelist><value>Size</value></includelist></class>"));
}

TEST_F(SpecificationManualTest, AClassWithoutAPropertyToCompareIsLeftOutButNotThoseBelow)
{
    EXPECT_EQ("INV_SolidStateDisk: Model Size", Compared(Element("INV_Disk", "") + Element("INV_SolidStateDisk", kInclude)));
}

TEST_F(SpecificationManualTest, TheTimeOfCollectionIsComparedOnlyIfItIsIncludedWithDefaultExclude)
{
    const std::string below = Element("INV_Package", kExclude) + Element("INV_Disk", kExclude);
    EXPECT_EQ("INV_Element: Model Size", Compared(Element("INV_Element", kInclude, "DateTimeOfCollection") + below));
    EXPECT_EQ("INV_Element: DateTimeOfCollection", Compared(Element("INV_Element", kExclude, "DateTimeOfCollection")));
}

TEST_F(SpecificationManualTest, NamesInAnotherLetterCase)
{
    // The class itself is not reached, those below are.
    EXPECT_EQ("INV_SolidStateDisk: Model Size", Compared(Element("inv_disk", kInclude)));
    EXPECT_EQ("INV_Rack: Model Size", Compared(Element("INV_Rack", kInclude, "", "size")));
    EXPECT_EQ("INV_Rack: size", Compared(Element("INV_Rack", kExclude, "size")));
    const std::string rules =
        Scratch("key", "<DifftoolSpec>" + Element("INV_Disk", "default='include' excludekeys='bootid'") + "</DifftoolSpec>");
    EXPECT_EQ(0u, Compare(Inventory("1", "7"), Inventory("1", "8"), {"--spec", rules}).find("4 differences "));
}

TEST_F(SpecificationManualTest, AnElementAfterItsAncestorsMergesIntoTheInheritedRules)
{
    // Its own default and listing win; the inherited listing of Model stays.
    EXPECT_EQ("INV_Disk: Model Size; INV_Element: Model; INV_Package: Model; INV_SolidStateDisk: Model Size",
              Compared(Element("INV_Element", kExclude, "Model") + Element("INV_Disk", kExclude, "Size")));
    EXPECT_EQ("INV_Disk: Size; INV_SolidStateDisk: Size",
              Compared(Element("INV_Element", kExclude, "", "Model") + Element("INV_Disk", kInclude)));
}

TEST_F(SpecificationManualTest, AnElementBeforeItsAncestorsIsReplaced)
{
    // The ancestor's default and listing of Size win; the class's own listing of Model stays.
    EXPECT_EQ("INV_Disk: Model; INV_SolidStateDisk: Model",
              Compared(Element("INV_Disk", kInclude, "Model") + Element("INV_Element", kExclude, "", "Size")));
}

TEST_F(SpecificationManualTest, AClassHasTwoElementsWithAnEffectOrOneAfterAnAncestor)
{
    EXPECT_EQ("INV_Rack: Model Size",
              Compared(Element("INV_Rack", kExclude) + Element("INV_Rack", kInclude) + Element("INV_Rack", kExclude)));
    EXPECT_EQ("INV_SolidStateDisk: Model Size", Compared(Element("INV_Disk", kExclude) + Element("INV_SolidStateDisk", kInclude) +
                                                         Element("INV_SolidStateDisk", kExclude)));
}

/// Inventories that differ in the key BootId alone.
class ExcludedKeysManualTest : public SpecificationManualTest {
  protected:
    /// How many differences each class has, or the messages.
    std::string Counts(const std::string& classes)
    {
        const std::string rules = Scratch("rules", "<DifftoolSpec>" + classes + "</DifftoolSpec>");
        const std::string report = Compare(Inventory("1", "7"), Inventory("1", "8"), {"--spec", rules});
        std::string counts;
        const std::regex lines("(INV_[A-Za-z]+)\n|([-+~]) [^\n]*\n|[^\n]*\n");
        for (std::sregex_iterator at(report.begin(), report.end(), lines), end; at != end; ++at) {
            counts += (*at)[1].matched ? (counts.empty() ? "" : "; ") + (*at)[1].str() + " " : "";
            counts += (*at)[2].str();
        }
        return counts;
    }
};

TEST_F(ExcludedKeysManualTest, TheyFlowDownToClassesWithoutRules)
{
    EXPECT_EQ("INV_Disk -+; INV_SolidStateDisk -+", Counts(Element("INV_Element", kInclude)));
    const std::string withoutBoot = Element("INV_Element", "default='include' excludekeys='BootId'", "");
    EXPECT_EQ("INV_Disk ~; INV_SolidStateDisk ~", Counts(withoutBoot));
    // Which have rules already keep their keys.
    EXPECT_EQ("INV_Disk ~; INV_SolidStateDisk -+", Counts(Element("INV_SolidStateDisk", kInclude) + withoutBoot));
    EXPECT_EQ("INV_Disk -+; INV_SolidStateDisk -+", Counts(Element("INV_Element", kInclude) + withoutBoot));
    EXPECT_EQ("INV_Disk -+; INV_SolidStateDisk -+",
              Counts(Element("INV_Element", kInclude) + Element("INV_Disk", "default='include' excludekeys='BootId'")));
}

TEST_F(ExcludedKeysManualTest, AnExcludedKeyRemainsAProperty)
{
    EXPECT_EQ("INV_Disk ~; INV_SolidStateDisk ~", Counts(Element("INV_Disk", "default='include' excludekeys='BootId'")));
    EXPECT_EQ("", Counts(Element("INV_Disk", "default='include' excludekeys='BootId'", "", "BootId")));
    EXPECT_EQ("", Counts(Element("INV_Disk", "default='exclude' excludekeys='BootId'", "Size")));
    EXPECT_EQ(0, fStatus);
}

TEST_F(ExcludedKeysManualTest, TwoElementsExcludeKeysBelowAnAncestor)
{
    const std::string keys = Element("INV_Disk", "excludekeys='BootId'");
    const std::string ancestor = Element("INV_Element", kInclude);
    EXPECT_EQ("", Counts(keys + ancestor + Element("INV_Disk", kExclude, "Size")));
    EXPECT_EQ(0, fStatus);
    EXPECT_EQ("", fErr);
    EXPECT_EQ("INV_Disk: Size; INV_Element: Model Size; INV_Package: Model Size; INV_SolidStateDisk: Size",
              Compared(keys + ancestor + Element("INV_Disk", kExclude, "Size")));
    // Without the second element the class has the ancestor's default and lists.
    EXPECT_EQ("INV_Disk ~; INV_SolidStateDisk ~", Counts(keys + ancestor));
    EXPECT_EQ("", fErr);
    EXPECT_EQ("", Counts(keys + Element("INV_Element", kExclude, "Size")));
    EXPECT_EQ("", fErr);
}

TEST_F(ExcludedKeysManualTest, OfInstancesThatShareAKeyTheFirstOfTheReferenceIsCompared)
{
    const auto disks = [](const std::string& first, const std::string& second) {
        const auto disk = [](const std::string& boot, const std::string& size) {
            return Instance("Disk", Value("BootId", boot) + Value("Size", size));
        };
        return Document(System() + Class("Disk", "", KeyProperty("BootId") + Declaration("Size", "string")) + disk("7", first) +
                        disk("8", second));
    };
    const std::string rules =
        Scratch("rules", "<DifftoolSpec>" + Element("Disk", "excludekeys='BootId'", "Size") + "</DifftoolSpec>");
    EXPECT_EQ(0, (Compare(disks("1", "2"), disks("1", "1"), {"--spec", rules}), fStatus));
    EXPECT_EQ(1, (Compare(disks("1", "2"), disks("2", "2"), {"--spec", rules}), fStatus));
    EXPECT_EQ(1, (Compare(disks("1", "1"), disks("1", "2"), {"--spec", rules}), fStatus));
    EXPECT_NE(std::string::npos, fOut.find(" with the key of an earlier one")) << fOut;
}

/// The examples of the manual, read from it, are accepted without a warning.
TEST_F(SpecificationManualTest, TheExamplesAreRulesWithoutWarnings)
{
    const std::string manual = ReadFile(std::string(CIMDELTA_FUZZ_FOLDER) + "/../docs/specification-file.md");
    const std::string inventory = Scratch(
        "manual.xml",
        Document(System() + Class("INV_Element", "", KeyProperty("Id") + Declaration("Caption", "string")) +
                 Class("INV_Package", "INV_Element", Declaration("InstalledOn", "string")) +
                 Class("INV_Process", "INV_Element", KeyProperty("ProcessId")) +
                 Class("INV_Disk", "", KeyProperty("BootId") + Declaration("SizeMB", "uint64") + Declaration("Model", "string"))));
    const std::regex example("```xml\n([^`]*)```");
    std::size_t count = 0;
    for (std::sregex_iterator at(manual.begin(), manual.end(), example), end; at != end; ++at, ++count) {
        const std::string rules = Scratch("example", (*at)[1].str());
        const std::string listing = Shorten(Result({"check", rules, "--schema", inventory}), rules, "R");
        EXPECT_NE(std::string::npos, listing.find(", 0 warnings\n")) << listing;
    }
    EXPECT_EQ(3u, count);
}

TEST_F(SpecificationManualTest, VersionsAreComparedAsText)
{
    for (const char* version : {"1.0", "1", "0.9", ""}) {
        Run({"check", Scratch("version", std::string("<DifftoolSpec version='") + version + "'/>")});
        EXPECT_EQ(0, fStatus) << version;
    }
    for (const char* version : {"1.1", "1.00", "10"}) {
        Run({"check", Scratch("version", std::string("<DifftoolSpec version='") + version + "'/>")});
        EXPECT_EQ(2, fStatus) << version;
    }
}

TEST_F(SpecificationManualTest, WhatIsIgnored)
{
    EXPECT_EQ("INV_Rack: Size",
              Compared("text<class name='INV_Rack'>text<includelist a='b'>text<value c='d'>Size</value>text</includelist>"
                       "text</class>text"));
}

}  // namespace
}  // namespace NORVZEL20
