// What options select is compared with what hand-written rules select, and with what the report without options says.
#include <gtest/gtest.h>

#include <algorithm>
#include <regex>

#include "tests/client/Documents.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

std::string ReferenceTo(const std::string& name, const std::string& path, const std::string& qualifiers = std::string())
{
    return "<PROPERTY.REFERENCE NAME=\"" + name + "\">" + qualifiers +
           (path.empty() ? "" : "<VALUE.REFERENCE>" + path + "</VALUE.REFERENCE>") + "</PROPERTY.REFERENCE>";
}

/// Element above Package, Kernel (a package) and Disk; a mount refers to a disk by key, an owner to a package.
std::string ElementInventory(const std::string& contents)
{
    return Document(System() + Class("Element", "", Declaration("Caption", "string") + Declaration("InstallDate", "string")) +
                    Class("Package", "Element", KeyProperty("Name") + Declaration("Version", "string")) +
                    Class("Kernel", "Package", Declaration("Flavour", "string")) +
                    Class("Disk", "Element", KeyProperty("Id") + KeyProperty("BootId") + Declaration("Size", "uint32")) +
                    Class("Mount", "", ReferenceTo("Device", "", kKey) + KeyProperty("Point") + Declaration("Options", "string")) +
                    Class("Owner", "", KeyProperty("Name") + ReferenceTo("Owned", "")) + contents);
}

std::string PackageOf(const std::string& cls, const std::string& name, const std::string& version, const std::string& date,
                      const std::string& more = std::string())
{
    return Instance(cls, Value("Name", name) + Value("Version", version) + Value("InstallDate", date) +
                             Value("Caption", name + " " + version) + more);
}

std::string DiskPath(const std::string& id, const std::string& boot)
{
    return "<INSTANCENAME CLASSNAME=\"Disk\"><KEYBINDING NAME=\"Id\"><KEYVALUE>" + id +
           "</KEYVALUE></KEYBINDING><KEYBINDING NAME=\"BootId\"><KEYVALUE>" + boot + "</KEYVALUE></KEYBINDING></INSTANCENAME>";
}

std::string DiskAt(const std::string& id, const std::string& boot, const std::string& size)
{
    return Instance("Disk", Value("Id", id) + Value("BootId", boot) + Value("Size", size, "uint32")) +
           Instance("Mount", ReferenceTo("Device", DiskPath(id, boot)) + Value("Point", "/" + id) + Value("Options", "rw" + size));
}

std::string RulesOf(const std::string& elements)
{
    return "<DifftoolSpec>" + elements + "</DifftoolSpec>";
}

std::string Include(const std::string& cls)
{
    return "<class name=\"" + cls + "\" default=\"include\"/>";
}

std::string ExcludeOf(const std::string& cls, const std::string& property)
{
    return "<class name=\"" + cls + "\" default=\"include\"><excludelist><value>" + property + "</value></excludelist></class>";
}

std::string IncludeOnly(const std::string& cls, const std::string& property)
{
    return "<class name=\"" + cls + "\"><includelist><value>" + property + "</value></includelist></class>";
}

const std::string kEverything = Include("&lt;root&gt;");

class SelectionTest : public TClientFixture {
  protected:
    void SetUp() override
    {
        TClientFixture::SetUp();
        fBefore = Scratch(
            "before.xml",
            ElementInventory(PackageOf("Package", "bash", "5.1", "mon") + PackageOf("Package", "telnet", "1", "mon") +
                             PackageOf("Kernel", "linux", "6.1", "mon", Value("Flavour", "rt")) + DiskAt("sda", "b1", "10") +
                             DiskAt("sdb", "b1", "20") +
                             Instance("Owner", Value("Name", "root") + ReferenceTo("Owned", Path("Package", "Name", "bash")))));
        fAfter = Scratch(
            "after.xml",
            ElementInventory(PackageOf("Package", "bash", "5.2", "tue") + PackageOf("Package", "curl", "8", "tue") +
                             PackageOf("Kernel", "linux", "6.2", "tue", Value("Flavour", "vm")) + DiskAt("sda", "b2", "10") +
                             DiskAt("sdb", "b2", "21") +
                             Instance("Owner", Value("Name", "root") + ReferenceTo("Owned", Path("Package", "Name", "curl")))));
    }

    std::string Compare(std::vector<std::string> options)
    {
        options.insert(options.begin(), {"compare", fBefore, fAfter});
        return Result(options);
    }

    /// The differences, one a line; of changed values "class instance property", otherwise "class instance kind".
    std::string Differences(std::vector<std::string> options)
    {
        options.insert(options.end(), {"-o", "ndjson"});
        const std::string all = Compare(options);
        return all.substr(0, all.rfind("\n", all.size() - 2) + 1);
    }

    std::string DifferencesUnder(const std::string& elements)
    {
        return Differences({"--spec", Scratch("by-hand.xml", RulesOf(elements))});
    }

    std::string Short(const std::string& text) { return Shorten(Shorten(text, fBefore, "before.xml"), fAfter, "after.xml"); }

    std::string fBefore;
    std::string fAfter;
};

TEST_F(SelectionTest, OptionsMeanWhatRulesByHandMean)
{
    const struct {
        std::vector<std::string> options;
        std::string rules;
    } rows[] = {
        {{"--class", "Package"}, Include("Package")},
        {{"--class", "kernel"}, Include("Kernel")},
        {{"--class", "*isk", "--class", "Own?r"}, Include("Disk") + Include("Owner")},
        {{"--class", "Element", "--exclude", "Package"}, Include("Element") + "<class name=\"Package\" default=\"exclude\"/>"},
        {{"--exclude", "Kernel"}, kEverything + "<class name=\"Kernel\" default=\"exclude\"/>"},
        {{"--exclude", "ELEMENT"}, kEverything + "<class name=\"Element\" default=\"exclude\"/>"},
        {{"--exclude", "*.InstallDate"}, kEverything + ExcludeOf("Element", "InstallDate")},
        {{"--exclude", "Package.InstallDate"}, kEverything + ExcludeOf("Package", "InstallDate")},
        {{"--exclude", "Kernel.*a*"},
         kEverything + "<class name=\"Kernel\" default=\"include\"><excludelist><value>Caption</value><value>InstallDate</value>"
                       "<value>Name</value><value>Flavour</value></excludelist></class>"},
        {{"--exclude", "Kernel.version", "--exclude", "Package.Caption"},
         kEverything + ExcludeOf("Package", "Caption") + ExcludeOf("Kernel", "Version")},
        {{"--property", "Version"}, IncludeOnly("Package", "Version")},
        {{"--property", "Kernel.Version"}, IncludeOnly("Kernel", "Version")},
        {{"--property", "Disk.Size", "--property", "Owned"}, IncludeOnly("Disk", "Size") + IncludeOnly("Owner", "Owned")},
        {{"--class", "Kernel", "--property", "Version"}, IncludeOnly("Kernel", "Version")},
        {{"--exclude-key", "BootId"}, "<class name=\"Disk\" excludekeys=\"BootId\"/>" + kEverything + ExcludeOf("Disk", "BootId")},
        {{"--exclude-key", "mount.device"},
         "<class name=\"Mount\" excludekeys=\"Device\"/>" + kEverything + ExcludeOf("Mount", "Device")},
        {{"--class", "Disk", "--exclude-key", "disk.boot*"},
         "<class name=\"Disk\" default=\"include\" "
         "excludekeys=\"BootId\"><excludelist><value>BootId</value></excludelist></class>"},
    };
    for (const auto& row : rows) {
        const std::string selected = Differences(row.options);
        EXPECT_NE("", selected) << row.options.back();
        EXPECT_EQ(DifferencesUnder(row.rules), selected) << row.options.back();
    }
}

TEST_F(SelectionTest, OptionsNarrowRules)
{
    const std::string rules =
        IncludeOnly("Element", "Caption") + ExcludeOf("Package", "Name") +
        "<class name=\"Kernel\" default=\"exclude\"><includelist><value>Flavour</value></includelist></class>";
    const std::string file = Scratch("rules.xml", RulesOf(rules));
    const std::string narrowed = Differences({"--spec", file, "--exclude", "*.caption", "--class", "Package"});
    EXPECT_NE("", narrowed);
    EXPECT_EQ(
        DifferencesUnder("<class name=\"Package\" default=\"include\"><excludelist><value>Name</value><value>Caption</value>"
                         "</excludelist></class><class name=\"Kernel\" default=\"exclude\"><includelist><value>Flavour</value>"
                         "</includelist></class>"),
        narrowed);
}

/// The differences without changes of the property, and without it in the contents of instances that only one side has.
std::string WithoutProperty(const std::string& property, const std::string& differences)
{
    std::string kept;
    for (std::size_t begin = 0; begin < differences.size();) {
        const std::size_t end = differences.find('\n', begin) + 1;
        const std::string line = differences.substr(begin, end - begin);
        if (line.find("\"kind\":\"changed\"") == std::string::npos ||
            line.find("\"property\":\"" + property + "\"") == std::string::npos) {
            kept += line;
        }
        begin = end;
    }
    kept = std::regex_replace(kept, std::regex("\"" + property + "\":\\{\"type\"[^}]*\\},?"), "");
    return std::regex_replace(kept, std::regex(",\\}\\}\n"), "}}\n");
}

TEST_F(SelectionTest, ExcludingAPropertyTakesItsChangesAndNothingElse)
{
    const std::string all = Differences({});
    std::size_t changed = 0;
    for (const std::string property : {"Caption", "InstallDate", "Version", "Flavour", "Owned", "Options"}) {
        const std::string expected = WithoutProperty(property, all);
        EXPECT_EQ(expected, Differences({"--exclude", "*." + property})) << property;
        changed += expected == all ? 0 : 1;
    }
    EXPECT_LT(3U, changed);
}

TEST_F(SelectionTest, SavedRulesGiveTheSameDifferences)
{
    const std::vector<std::vector<std::string>> selections = {
        {}, {"--class", "Package"}, {"--exclude", "*.InstallDate", "--exclude-key", "BootId"}, {"--property", "*s*"}};
    const std::string rules =
        Scratch("rules.xml", RulesOf(Include("Element") + ExcludeOf("Package", "Caption") + Include("Mount")));
    for (const std::string& spec : {std::string(), rules}) {
        for (std::vector<std::string> options : selections) {
            if (!spec.empty()) {
                options.insert(options.end(), {"--spec", spec});
            }
            const std::string file = Scratch("saved.xml", "");
            options.insert(options.end(), {"--save-rules", file});
            const std::string before = Differences(options);
            EXPECT_NE("", before);
            EXPECT_EQ(before, Differences({"--spec", file})) << ReadFile(file);
        }
    }
}

TEST_F(SelectionTest, SavedRulesSayWhatMadeThem)
{
    const std::string file = Scratch("saved.xml", "");
    Compare({"--exclude", "*.InstallDate", "--exclude-key", "Disk.BootId", "--save-rules", file});
    EXPECT_EQ("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
              "<!-- Saved by cimdelta compare.\n"
              "     Everything is compared, except as these options say:\n"
              "       exclude '*.InstallDate'\n"
              "       exclude-key Disk.BootId -->\n"
              "<DifftoolSpec version=\"1.0\">\n"
              "  <class name=\"Disk\" excludekeys=\"BootId\"/>\n"
              "  <class name=\"&lt;root&gt;\" default=\"include\"/>\n"
              "  <class name=\"Element\" default=\"include\">\n"
              "    <excludelist>\n"
              "      <value>InstallDate</value>\n"
              "    </excludelist>\n"
              "  </class>\n"
              "  <class name=\"Disk\" default=\"include\">\n"
              "    <excludelist>\n"
              "      <value>BootId</value>\n"
              "    </excludelist>\n"
              "  </class>\n"
              "</DifftoolSpec>\n",
              ReadFile(file));
}

TEST_F(SelectionTest, RulesAreNotSavedIfTheComparisonFails)
{
    const std::string file = Scratch("saved.xml", "as it was");
    Complaint({"compare", fBefore, fAfter, "--class", "Nothing", "--save-rules", file});
    EXPECT_EQ("as it was", ReadFile(file));
}

TEST_F(SelectionTest, TheReportSaysWhatOptionsLeaveOut)
{
    const std::string report = Compare({"--exclude", "*.InstallDate", "--exclude", "Owner"});
    EXPECT_NE(std::string::npos, report.find("3 properties left out by --exclude '*.InstallDate' --exclude Owner (--coverage)"))
        << report;
    const std::string whole = Compare({"--exclude", "Package.InstallDate", "--exclude", "Owner", "--coverage"});
    EXPECT_NE(std::string::npos,
              whole.find("Not compared, because of --exclude Package.InstallDate --exclude Owner: Owner (1 / 1).\n"))
        << whole;
    EXPECT_NE(
        std::string::npos,
        whole.find("Properties of Package and 1 class below it not compared, because of --exclude Package.InstallDate --exclude "
                   "Owner: InstallDate.\n"))
        << whole;
}

TEST_F(SelectionTest, NamesThatMeanNothingAreErrors)
{
    const struct {
        std::vector<std::string> options;
        std::string message;
    } rows[] = {
        {{"--class", "Pakage"}, "--class Pakage: the reference declares no such class; did you mean Package?"},
        {{"--class", "Zzz*"}, "--class Zzz*: the reference declares no such class"},
        {{"--class", "Package.Name"}, "--class Package.Name: is no class; name properties with --property"},
        {{"--class", "Version"},
         "--class Version: the reference declares no such class; for the property, write --property Version"},
        {{"--exclude", "InstallDate"},
         "--exclude InstallDate: the reference declares no such class; for the property, write --exclude '*.InstallDate'"},
        {{"--property", "Versoin"}, "--property Versoin: no class has such a property; did you mean Version?"},
        {{"--property", "Disk.Version"}, "--property Disk.Version: the classes that it names have no such property"},
        {{"--exclude", "Dsk.Size"}, "--exclude Dsk.Size: the reference declares no such class; did you mean Disk?"},
        {{"--exclude-key", "Size"},
         "--exclude-key Size: no class has such a key; a property that is no key is left out with --exclude"},
        {{"--exclude-key", "Disk.BotId"},
         "--exclude-key Disk.BotId: the classes that it names have no such key; did you mean BootId?"},
        {{"--exclude", "Disk."}, "--exclude Disk.: has nothing on one side of the dot; write CLASS.NAME"},
    };
    for (const auto& row : rows) {
        std::vector<std::string> arguments{"compare", fBefore, fAfter};
        arguments.insert(arguments.end(), row.options.begin(), row.options.end());
        EXPECT_EQ("cimdelta: " + row.message + "\n", Complaint(arguments));
    }
}

TEST_F(SelectionTest, APropertyThatIsNotComparedCannotBeSelected)
{
    const std::string rules = Scratch("rules.xml", RulesOf(ExcludeOf("Package", "Version")));
    EXPECT_EQ(
        "cimdelta: --property Version: is not compared without the option either; cimdelta explain Package.Version says why\n",
        Complaint({"compare", fBefore, fAfter, "--spec", rules, "--property", "Version"}));
}

TEST_F(SelectionTest, NothingThatOptionsLeaveIsAnError)
{
    EXPECT_EQ(
        "cimdelta: nothing was compared: --exclude '*' leaves out Disk, KALMO_OperatingSystem, Kernel, Mount, Owner, Package; "
        "name others in the options, or leave the options out, or accept this with --allow-empty\n",
        Complaint({"compare", fBefore, fAfter, "--exclude", "*"}));
}

TEST_F(SelectionTest, OnlySomeKindsAreShown)
{
    const struct {
        std::string kinds;
        std::vector<std::string> shown;
        std::string first;
    } rows[] = {
        {"+",
         {"onlyInOthers"},
         "before -> after: 5 differences (+5 instances) in 3 of 6 classes; 5 missing instances, 8 changed values not shown (--only "
         "+)"},
        {"-,added",
         {"onlyInReference", "onlyInOthers"},
         "before -> after: 10 differences (-5 +5 instances) in 3 of 6 classes; 8 changed values not shown (--only -,added)"},
        {"~",
         {"changed"},
         "before -> after: 8 differences (8 values) in 3 of 6 classes; 5 missing instances, 5 added instances not shown (--only "
         "~)"},
        {"~,+,-",
         {"changed", "onlyInReference", "onlyInOthers"},
         "before -> after: 18 differences (-5 +5 instances, 8 values) in 5 of 6 classes"},
    };
    const std::string all = Differences({});
    for (const auto& row : rows) {
        std::string expected;
        for (std::size_t begin = 0; begin < all.size(); begin = all.find('\n', begin) + 1) {
            const std::string line = all.substr(begin, all.find('\n', begin) + 1 - begin);
            if (std::any_of(row.shown.begin(), row.shown.end(), [&line](const std::string& kind) {
                    return line.find("\"kind\":\"" + kind + "\"") != std::string::npos;
                })) {
                expected += line;
            }
        }
        EXPECT_EQ(expected, Differences({"--only=" + row.kinds}));
        std::string report = Compare({"--only=" + row.kinds});
        report.erase(report.find('\n'));
        EXPECT_EQ(row.first, Shorten(report, "cimdelta-test-" + std::to_string(getpid()) + "-", ""));
    }
}

TEST_F(SelectionTest, TheStatusCountsWhatIsShown)
{
    Compare({"--class", "Owner", "--only", "+,-"});
    EXPECT_EQ(0, fStatus);
    EXPECT_EQ("No differences of the kinds to be shown between before and after; 1 changed value not shown (--only +,-).",
              Shorten(fOut.substr(0, fOut.find('\n')), "cimdelta-test-" + std::to_string(getpid()) + "-", ""));
    Compare({"--class", "Owner", "--only", "changed"});
    EXPECT_EQ(1, fStatus);
}

TEST_F(SelectionTest, JsonSaysWhatIsNotShown)
{
    const std::string json = Compare({"--class", "Owner", "--only", "+,-", "-o", "json"});
    EXPECT_NE(std::string::npos,
              json.find("\"notShown\": {\n      \"option\": \"--only +,-\",\n      \"onlyInReference\": 0,\n      "
                        "\"onlyInOthers\": 0,\n      \"changedValues\": 1\n    }"))
        << json;
}

TEST_F(SelectionTest, ArgumentsThatCannotBeAreErrors)
{
    const std::string rules = Scratch("saved.xml", "");
    const struct {
        std::vector<std::string> options;
        std::string message;
    } rows[] = {
        {{"--only", "+", "-o", "cimxml"},
         "--only cannot be used with -o cimxml, which has all records of the comparison; leave one of them out"},
        {{"--only", "+", "--accept", rules},
         "--only cannot be used with --accept, which keeps all differences, shown or not; leave one of them out"},
        {{"--save-rules", "-"}, "--save-rules writes a file, since the result goes to standard output; name a file"},
    };
    for (const auto& row : rows) {
        std::vector<std::string> arguments{"compare", fBefore, fAfter};
        arguments.insert(arguments.end(), row.options.begin(), row.options.end());
        EXPECT_EQ("cimdelta: " + row.message + "\n", Complaint(arguments));
    }
    EXPECT_NE(std::string::npos,
              Complaint({"compare", fBefore, fAfter, "--only", "/root"})
                  .find("--only /root is no list of kinds; name some of +, - and ~, or added, missing and changed "
                        "(the shell replaces a ~ that stands alone)"));

    EXPECT_EQ("cimdelta: after.xml: is one of the files that are read; name another file for the result\n",
              Short(Complaint({"compare", fBefore, fAfter, "--save-rules", fAfter})));
}

}  // namespace
}  // namespace NORVZEL20
