#include "tests/client/report/TGroupedFixture.h"

namespace NORVZEL20 {
namespace {

/// Instances with keys of several parts.
class TellingKeyTest : public TGroupedFixture {
  protected:
    using TRow = std::vector<std::string>;

    /// A system that holds things with these values of its keys, which are declared in that order, and one version of all.
    void Things(const std::string& name, const TRow& keys, const std::vector<TRow>& things, const std::string& version)
    {
        std::string declarations = Declaration("Version", "string");
        for (const std::string& key : keys) {
            declarations += key == "Unit" ? Declaration(key, "uint32", kKey) : KeyProperty(key);
        }
        std::string contents = Class("Thing", "", declarations);
        for (const TRow& thing : things) {
            std::string values = Value("Version", version);
            for (std::size_t i = 0; i < keys.size(); ++i) {
                values += Value(keys[i], thing[i], keys[i] == "Unit" ? "uint32" : "string");
            }
            contents += Instance("Thing", values);
        }
        System(name, contents);
    }

    /// The names by which a report calls things that changed.
    std::string Names(const TRow& keys, const std::vector<TRow>& things)
    {
        fSystems.clear();
        Things("a", keys, things, "1");
        Things("b", keys, things, "2");
        const std::string findings = Findings();
        const std::string begin = "Version: 1 -> 2: ";
        return findings.substr(findings.find(begin) + begin.size());
    }
};

TEST_F(TellingKeyTest, IsTheWholeNameIfItTellsAllApart)
{
    const struct {
        TRow keys;
        std::vector<TRow> things;
        const char* names;
    } rows[] = {
        {{"Arch", "Name"}, {{"amd64", "curl"}, {"all", "font"}, {"all", "less"}}, "font, less, curl\n"},
        // It does not.
        {{"Name", "Arch"}, {{"curl", "amd64"}, {"curl", "i386"}}, "amd64, i386\n"},
        {{"Name", "Arch"},
         {{"curl", "amd64"}, {"curl", "i386"}, {"font", "i386"}},
         "Name=curl,Arch=amd64; Name=curl,Arch=i386; Name=font,Arch=i386\n"},
        // Of several keys that do so because there are few things, only Name.
        {{"Arch", "Name"}, {{"amd64", "curl"}, {"all", "font"}}, "font, curl\n"},
        {{"Arch", "Id"}, {{"amd64", "curl"}, {"all", "font"}}, "Arch=all,Id=font; Arch=amd64,Id=curl\n"},
        {{"Arch", "Id"}, {{"all", "curl"}, {"all", "font"}, {"amd64", "less"}}, "curl, font, less\n"},
        // A number is no name.
        {{"Bus", "Unit"}, {{"x", "1"}, {"x", "2"}, {"y", "3"}}, "Bus=x,Unit=1; Bus=x,Unit=2; Bus=y,Unit=3\n"},
        {{"Arch", "Name"}, {{"all", "a,b"}, {"all", "c"}, {"any", "d"}}, "\"a,b\"; c; d\n"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.names, Names(row.keys, row.things));
    }
}

// "curl" alone could be either of them.
TEST_F(TellingKeyTest, MustTellApartInAllInventories)
{
    Things("a", {"Name", "Arch"}, {{"curl", "amd64"}, {"font", "all"}, {"less", "all"}}, "1");
    Things("b", {"Name", "Arch"}, {{"curl", "amd64"}, {"font", "all"}, {"less", "all"}}, "2");
    Things("c", {"Name", "Arch"}, {{"curl", "i386"}, {"font", "all"}, {"less", "all"}}, "1");
    EXPECT_EQ("Thing  -1 +1 ~3   missing in c: Name=curl,Arch=amd64;  only in c: Name=curl,Arch=i386\n"
              "    Version: 1 -> 2 (b): Name=font,Arch=all; Name=less,Arch=all; Name=curl,Arch=amd64\n",
              Findings());
}

TEST_F(TellingKeyTest, FullNamesHaveAllKeys)
{
    Things("a", {"Name", "Arch"}, {{"curl", "amd64"}, {"font", "all"}}, "1");
    Things("b", {"Name", "Arch"}, {{"curl", "amd64"}}, "1");
    EXPECT_EQ("Thing  - font   Version 1\n", Findings());
    EXPECT_EQ("Thing  - Arch=\"all\",Name=\"font\"   Version 1\n", Findings({"--full"}));
}

}  // namespace
}  // namespace NORVZEL20
