#include "tests/client/report/TGroupedFixture.h"

namespace NORVZEL20 {
namespace {

/// Values whose declaration says what they mean.
class ValueMeaningTest : public TGroupedFixture {
  protected:
    static std::string QualifierOf(const std::string& name, const std::string& text)
    {
        return "<QUALIFIER NAME=\"" + name + "\" TYPE=\"string\"><VALUE>" + text + "</VALUE></QUALIFIER>";
    }

    static std::string Lists(const std::string& name, const std::vector<std::string>& texts)
    {
        std::string values;
        for (const std::string& text : texts) {
            values += "<VALUE>" + text + "</VALUE>";
        }
        return "<QUALIFIER NAME=\"" + name + "\" TYPE=\"string\"><VALUE.ARRAY>" + values + "</VALUE.ARRAY></QUALIFIER>";
    }

    void Disk(const std::string& name, const std::string& values)
    {
        const std::string health =
            Lists("ValueMap", {"2", "3", "5..10", ".."}) + Lists("Values", {"OK", "Degraded", "Lost, all", "Other"});
        const std::string schema =
            "<QUALIFIER.DECLARATION NAME=\"ValueMap\" TYPE=\"string\" ISARRAY=\"true\"/>"
            "<QUALIFIER.DECLARATION NAME=\"Values\" TYPE=\"string\" ISARRAY=\"true\"/>"
            "<QUALIFIER.DECLARATION NAME=\"PUnit\" TYPE=\"string\"/><QUALIFIER.DECLARATION NAME=\"Units\" TYPE=\"string\"/>" +
            Class("Disk", "",
                  KeyProperty("Name") + Declaration("Health", "uint16", health) +
                      Declaration("Size", "uint64", QualifierOf("PUnit", "byte * 2^10")) +
                      Declaration("Clock", "uint32", QualifierOf("Units", "MegaHertz")) + Declaration("Installed", "datetime") +
                      Declaration("Uptime", "datetime") + ListDeclaration("States", "uint16", health));
        System(name, schema + values);
    }
};

TEST_F(ValueMeaningTest, IsWrittenBesideTheNumber)
{
    const std::string same = Instance("Disk", Value("Name", "sdz"));
    Disk("a",
         same + Instance("Disk", Value("Name", "sda") + Value("Health", "2", "uint16") + Value("Size", "524288", "uint64") +
                                     Value("Clock", "100", "uint32") + Value("Installed", "20240131100000.000000+060", "datetime") +
                                     Value("Uptime", "00000003040506.000000:000", "datetime") + List("States", {"2"}, "uint16")));
    Disk("b",
         same +
             Instance("Disk", Value("Name", "sda") + Value("Health", "7", "uint16") + Value("Size", "524289", "uint64") +
                                  Value("Clock", "200", "uint32") + Value("Installed", "20240131100000.000000+000", "datetime") +
                                  Value("Uptime", "00000003040507.000000:000", "datetime") + List("States", {"2", "3"}, "uint16")) +
             Instance("Disk", Value("Name", "sdb") + Value("Health", "99", "uint16") + Value("Size", "1048576", "uint64")));
    EXPECT_EQ("Disk  + sdb   Health 99 Other, Size 1 GiB\n"
              "      ~ sda.Clock: 100 MHz -> 200 MHz\n"
              "      ~ sda.Health: 2 OK -> 7 \"Lost, all\"\n"
              "      ~ sda.Installed: 2024-01-31 10:00:00 +01:00 -> 2024-01-31 10:00:00 +00:00\n"
              "      ~ sda.Size: 512 MiB -> 512 MiB (536871936 bytes)\n"
              "      ~ sda.States: {2 OK} -> {2 OK, 3 Degraded}\n"
              "      ~ sda.Uptime: 3 d 04:05:06 -> 3 d 04:05:07\n",
              Findings());
    EXPECT_NE(std::string::npos, Compare({"-o", "markdown"})
                                     .find("- `+ sdb   Health 99 Other, Size 1 GiB`\n"
                                           "- `~ sda.Clock: 100 MHz -> 200 MHz`\n"
                                           "- `~ sda.Health: 2 OK -> 7 \"Lost, all\"`\n"));
}

}  // namespace
}  // namespace NORVZEL20
