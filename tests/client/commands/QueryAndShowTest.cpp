#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

class QueryAndShowTest : public TClientFixture {};

TEST_F(QueryAndShowTest, AQueryGivesTheListedPropertiesInItsOrder)
{
    EXPECT_EQ("INV_Package.Name=\"bash\"\n"
              "    Version: 5.1\n"
              "    Name: bash\n"
              "INV_Package.Name=\"nginx\"\n"
              "    Version: 1.22\n"
              "    Name: nginx\n",
              Result({"query", "SELECT Version, Name FROM INV_Package WHERE Size > 50", "web01.xml"}));
    EXPECT_EQ(0, fStatus);
}

TEST_F(QueryAndShowTest, AQueryThatNothingAnswersIsNoTrouble)
{
    EXPECT_EQ("", Result({"query", "SELECT * FROM INV_Package WHERE Size > 5000", "web01.xml"}));
    EXPECT_EQ("[]\n", Result({"query", "SELECT * FROM INV_Package WHERE Size > 5000", "web01.xml", "-o", "json"}));
    EXPECT_EQ(0, fStatus);
}

TEST_F(QueryAndShowTest, ValuesKeepTheirTypesInJson)
{
    EXPECT_EQ("{\"class\":\"INV_Service\",\"instance\":\"INV_Service.Id=\\\"ssh\\\"\",\"properties\":{\"Id\":\"ssh\",\"Caption\":"
              "\"Secure "
              "shell\",\"Started\":true}}\n",
              Result({"query", "SELECT * FROM INV_Element", "-o", "ndjson", "web01.xml"}));
    EXPECT_EQ("{\"class\":\"INV_Package\",\"instance\":\"INV_Package.Name=\\\"nginx\\\"\",\"properties\":{\"Size\":2000,"
              "\"Depends\":null}}\n",
              Result({"query", "SELECT Size, Depends FROM INV_Package WHERE Name = 'nginx'", "-o", "ndjson", "web01.xml"}));
}

TEST_F(QueryAndShowTest, AWrongQueryIsReportedWithItsColumn)
{
    EXPECT_EQ("cimdelta: query, column 10: expected FROM, found 'FORM'\n",
              Complaint({"query", "SELECT * FORM INV_Disk", "web01.xml"}));
    EXPECT_EQ("cimdelta: query, column 15: there is no class 'Nix'\n", Complaint({"query", "SELECT * FROM Nix", "web01.xml"}));
}

TEST_F(QueryAndShowTest, ShowListsTheClassTree)
{
    EXPECT_EQ("KALMO_OperatingSystem: 1 instance\n"
              "INV_Package: 3 instances\n"
              "INV_Disk: 1 instance\n"
              "INV_Element: 0 instances\n"
              "  INV_Service: 1 instance\n",
              Result({"show", "web01.xml"}));
    const std::string lines = Result({"show", "web01.xml", "-o", "ndjson"});
    EXPECT_EQ("{\"class\":\"INV_Element\",\"superclass\":null,\"instances\":0}\n"
              "{\"class\":\"INV_Service\",\"superclass\":\"INV_Element\",\"instances\":1}\n",
              lines.substr(lines.find("{\"class\":\"INV_Element\"")));
}

TEST_F(QueryAndShowTest, ShowListsAClassWithThoseBelowIt)
{
    EXPECT_EQ("INV_Service.Id=\"ssh\"\n"
              "    Id: ssh\n"
              "    Caption: Secure shell\n"
              "    Started: TRUE\n",
              Result({"show", "web01.xml", "inv_element"}));
    EXPECT_EQ("cimdelta: web01.xml: declares no class Nix; cimdelta show web01.xml lists those it declares\n",
              Complaint({"show", "web01.xml", "Nix"}));
}

TEST_F(QueryAndShowTest, CimXmlOfAnInventoryIsThatInventory)
{
    const std::string copy = Scratch("copy.xml", Result({"show", "web01.xml", "-o", "cimxml"}));
    EXPECT_EQ(0u, Result({"compare", "--detail", "web01.xml", copy}).find("No differences between "));
    const std::string part = Scratch("part.xml", Result({"query", "SELECT * FROM INV_Element", "-o", "cimxml", "web01.xml"}));
    EXPECT_EQ(Result({"show", "web01.xml", "INV_Service"}), Result({"show", part, "INV_Service"}));
}

}  // namespace
}  // namespace NORVZEL20
