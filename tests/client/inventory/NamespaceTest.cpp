#include <nlohmann/json.hpp>
#include <sstream>

#include "tests/client/Documents.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

std::string PathInto(const std::string& ns, const std::string& disk)
{
    return "<LOCALINSTANCEPATH><LOCALNAMESPACEPATH><NAMESPACE NAME=\"" + ns + "\"/></LOCALNAMESPACEPATH>" +
           Path("Disk", "Id", disk) + "</LOCALINSTANCEPATH>";
}

/// An inventory with a link for each of the paths.
std::string Links(const std::vector<std::string>& paths, const std::string& ns = std::string(),
                  const std::string& disks = std::string())
{
    int id = 0;
    std::string contents =
        Class("Disk", "", KeyProperty("Id")) + Class("Link", "", KeyProperty("Id") + "<PROPERTY.REFERENCE NAME=\"To\"/>");
    for (const std::string& path : paths) {
        contents += Instance("Link", Value("Id", std::to_string(++id)) + "<PROPERTY.REFERENCE NAME=\"To\"><VALUE.REFERENCE>" +
                                         path + "</VALUE.REFERENCE></PROPERTY.REFERENCE>");
    }
    return Document(System() + contents + disks, ns);
}

const std::string kDisks = Instance("Disk", Value("Id", "sda")) + Instance("Disk", Value("Id", "sdb"));

/// In which namespace an inventory is that does not name its own.
class NamespaceTest : public TClientFixture {
  protected:
    /// What the links refer to, in the order of the document, one in each line.
    std::string Targets(const std::string& file, const std::vector<std::string>& options = {})
    {
        std::vector<std::string> arguments = {"query", "SELECT To FROM Link", file};
        arguments.insert(arguments.end(), options.begin(), options.end());
        Run(arguments);
        EXPECT_EQ(0, fStatus) << fErr;
        std::istringstream lines(fOut);
        std::string targets;
        for (std::string line; std::getline(lines, line);) {
            targets += line.rfind("    To: ", 0) == 0 ? "To " + line.substr(8) + "\n" : "";
        }
        return targets;
    }
};

TEST_F(NamespaceTest, TheOptionDecidesIfReferencesNameSeveral)
{
    const std::string file = Scratch("a.xml", Links({PathInto("root/hw", "sda"), PathInto("root/sw", "sdb")}));
    EXPECT_EQ("To root/hw:Disk.Id=\"sda\"\n"
              "To root/sw:Disk.Id=\"sdb\"\n",
              Targets(file));
    EXPECT_EQ("cimdelta: a: names no namespace, and its references are to root/hw, root/sw; taken as root/cimv2; say which with "
              "--namespace [LABEL=]NAME\n",
              Shorten(fErr, file, "a"));
    EXPECT_EQ("To Disk.Id=\"sda\"\n"
              "To root/sw:Disk.Id=\"sdb\"\n",
              Targets(file, {"--namespace", "/Root/HW/"}));
    EXPECT_EQ("", fErr);
    Targets(file, {"--namespace", "root/x"});
    EXPECT_EQ("cimdelta: a: names no namespace, and its references are to root/hw, root/sw; taken as root/x, as --namespace says\n",
              Shorten(fErr, file, "a"));
}

TEST_F(NamespaceTest, TheOneThatAllReferencesNameIsTakenBeforeTheOption)
{
    const std::string file = Scratch("a.xml", Links({PathInto("root/hw", "sda"), Path("Disk", "Id", "sdb")}, "", kDisks));
    EXPECT_EQ("To Disk.Id=\"sda\"\nTo Disk.Id=\"sdb\"\n", Targets(file));
    EXPECT_EQ("", fErr);
    EXPECT_EQ("To Disk.Id=\"sda\"\nTo Disk.Id=\"sdb\"\n", Targets(file, {"--namespace", "root/x"}));
    EXPECT_EQ("cimdelta: a: all references are to namespace root/hw, so --namespace root/x is not used for it\n",
              Shorten(fErr, file, "a"));
}

TEST_F(NamespaceTest, TheOneThatTheDocumentNamesIsTakenBeforeTheOption)
{
    const std::string file = Scratch(
        "a.xml", "<CIM><DECLARATION><DECLGROUP.WITHNAME><LOCALNAMESPACEPATH><NAMESPACE NAME=\"root/hw\"/></LOCALNAMESPACEPATH>" +
                     Class("Disk", "", Declaration("Id", "string")) + "</DECLGROUP.WITHNAME></DECLARATION></CIM>");
    Run({"show", file, "--namespace", "root/x"});
    EXPECT_EQ("cimdelta: a: is in namespace root/hw, so --namespace root/x is not used for it\n", Shorten(fErr, file, "a"));
}

TEST_F(NamespaceTest, IdenticalContentsOfTwoNamespacesAreEqual)
{
    const auto links = [](const std::string& ns) {
        return Links({PathInto(ns, "sda"), Path("Disk", "Id", "sdb"), PathInto(ns, "sdc")}, "", kDisks);
    };
    const std::string a = Scratch("a.xml", links("root/hw"));
    const std::string b = Scratch("b.xml", links("root/sw"));
    const std::string report = Result({"compare", "--detail", "a=" + a, "b=" + b});
    EXPECT_EQ(0u, report.find("No differences between a and b.\n")) << report;
    EXPECT_NE(std::string::npos, report.find("Namespace of a: root/hw, the one that its references name.\n"
                                             "Namespace of b: root/sw, the one that its references name.\n"))
        << report;
}

/// References without a namespace are to the own one, so another that leads nowhere is foreign: where it leads, matters.
TEST_F(NamespaceTest, ReferencesIntoForeignNamespacesDiffer)
{
    const auto links = [](const std::string& ns) { return Links({PathInto(ns, "lun0"), Path("Disk", "Id", "sdb")}, "", kDisks); };
    const std::string a = Scratch("a.xml", links("root/hw"));
    const std::string b = Scratch("b.xml", links("root/sw"));
    Run({"compare", "--detail", "a=" + a, "b=" + b});
    EXPECT_EQ(0u, fOut.find("1 difference between a and b: ")) << fOut;
    EXPECT_NE(std::string::npos,
              fOut.find("Namespace of a: root/cimv2, since its references into root/hw lead to nothing in it.\n"))
        << fOut;
    const std::string doubt = "; say which with --namespace [LABEL=]NAME\n";
    EXPECT_EQ("cimdelta: a: names no namespace, and its references are to root/hw; taken as root/cimv2" + doubt +
                  "cimdelta: b: names no namespace, and its references are to root/sw; taken as root/cimv2" + doubt,
              Shorten(Shorten(fErr, "a=" + a, "a"), "b=" + b, "b"));
}

TEST_F(NamespaceTest, EachInventoryMayGetItsOwn)
{
    const auto links = [](const std::string& ns) { return Links({PathInto(ns, "sda"), PathInto("root/other", "sdb")}); };
    const std::string a = "a=" + Scratch("a.xml", links("root/hw"));
    const std::string b = "b=" + Scratch("b.xml", links("root/sw"));
    const std::string report = Result({"compare", "--detail", a, b, "--namespace", "a=root/hw", "--namespace", "b=root/sw"});
    EXPECT_EQ(0u, report.find("No differences between a and b.\n")) << report;
    EXPECT_NE(std::string::npos, report.find("Namespace of b: root/sw, as --namespace says.\n")) << report;
    const nlohmann::json inventories = nlohmann::json::parse(
        Result({"compare", "-o", "json", a, b, "--namespace", "a=root/hw", "--namespace", "root/sw"}))["inventories"];
    EXPECT_EQ("root/hw option root/sw option",
              inventories[0]["namespace"].get<std::string>() + " " + inventories[0]["namespaceFrom"].get<std::string>() + " " +
                  inventories[1]["namespace"].get<std::string>() + " " + inventories[1]["namespaceFrom"].get<std::string>());
    EXPECT_EQ("cimdelta: --namespace c=x: no inventory has the label c; name one of these: a, b\n",
              Complaint({"compare", a, b, "--namespace", "c=x"}));
    EXPECT_EQ("cimdelta: --namespace y: another one, x, is named for the same inventories; name it once, or put LABEL= in front of "
              "each\n",
              Complaint({"compare", a, b, "--namespace", "x", "--namespace", "y"}));
}

TEST_F(NamespaceTest, AWrongNameIsRefusedBeforeInventoriesAreRead)
{
    const std::string a = "a=" + Scratch("a.xml", "no XML");
    const std::string expected = ", expected the name of a namespace, such as root/cimv2, without blanks, colons and quotes\n";
    const struct {
        std::string option;
        std::string message;
    } rows[] = {
        {"a=", "a=: found no name, expected [LABEL=]NAME, such as root/cimv2\n"},
        {"//", "//: found no name, expected [LABEL=]NAME, such as root/cimv2\n"},
        {"=x", "=x: found an empty label, expected [LABEL=]NAME\n"},
        {"a b", "a b: found \"a b\"" + expected},
        {"a=root/hw ", "a=root/hw : found \"root/hw \"" + expected},
        {"a=http://host/root", "a=http://host/root: found \"http://host/root\"" + expected},
    };
    for (const auto& row : rows) {
        EXPECT_EQ("cimdelta: --namespace " + row.message, Complaint({"show", a, "--namespace", row.option}));
    }
}

}  // namespace
}  // namespace NORVZEL20
