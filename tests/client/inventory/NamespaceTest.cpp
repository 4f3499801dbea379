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
std::string Links(const std::vector<std::string>& paths, const std::string& ns = std::string())
{
    int id = 0;
    std::string contents =
        Class("Disk", "", KeyProperty("Id")) + Class("Link", "", KeyProperty("Id") + "<PROPERTY.REFERENCE NAME=\"To\"/>");
    for (const std::string& path : paths) {
        contents += Instance("Link", Value("Id", std::to_string(++id)) + "<PROPERTY.REFERENCE NAME=\"To\"><VALUE.REFERENCE>" +
                                         path + "</VALUE.REFERENCE></PROPERTY.REFERENCE>");
    }
    return Document(System() + contents, ns);
}

/// In which namespace an inventory is that does not name its own.
class NamespaceTest : public TClientFixture {
  protected:
    /// What the links refer to, in the order of the document, one in each line.
    std::string Targets(const std::string& file, const std::vector<std::string>& options = {})
    {
        std::vector<std::string> arguments = {"query", "SELECT To FROM Link", file};
        arguments.insert(arguments.end(), options.begin(), options.end());
        std::istringstream lines(Result(arguments));
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
    EXPECT_EQ("To Disk.Id=\"sda\"\n"
              "To root/sw:Disk.Id=\"sdb\"\n",
              Targets(file, {"--namespace", "/Root/HW/"}));
}

}  // namespace
}  // namespace NORVZEL20
