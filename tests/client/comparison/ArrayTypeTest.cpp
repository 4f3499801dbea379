#include "tests/client/TDocumentsFixture.h"

namespace NORVZEL20 {
namespace {

/// Whether the order of an array counts is said by the declaration of the reference, also among the other inventories.
class ArrayTypeTest : public TDocumentsFixture {
  protected:
    /// An inventory with a disk of these names, or with none if there are no names.
    static std::string Names(const std::string& arrayType, const std::string& names)
    {
        std::string values;
        for (const char name : names) {
            values += "<VALUE>" + std::string(1, name) + "</VALUE>";
        }
        const std::string qualifier = "<QUALIFIER NAME=\"ArrayType\" TYPE=\"string\"><VALUE>" + arrayType + "</VALUE></QUALIFIER>";
        const std::string array = "<PROPERTY.ARRAY NAME=\"Names\" TYPE=\"string\">";
        return Class("Disk", "", KeyProperty("Id") + array + qualifier + "</PROPERTY.ARRAY>") +
               (names.empty()
                    ? std::string()
                    : Instance("Disk", Value("Id", "1") + array + "<VALUE.ARRAY>" + values + "</VALUE.ARRAY></PROPERTY.ARRAY>"));
    }
};

TEST_F(ArrayTypeTest, OfTheReferenceHoldsAmongTheOthers)
{
    const char kAlike[] = "Disk\n+ Id=\"1\"  (in b, c)\n";
    const char kApart[] = "Disk\n+ Id=\"1\"  (in b, c)\n    Names: b: {\"x\", \"y\"} / c: {\"y\", \"x\"}\n";
    const char kChangedAlike[] = "Disk\n~ Id=\"1\"\n    Names: {\"z\"} -> b, c: {\"x\", \"y\"}\n";
    const char kChangedApart[] = "Disk\n~ Id=\"1\"\n    Names: {\"z\"} -> b: {\"x\", \"y\"} / c: {\"y\", \"x\"}\n";
    const struct {
        std::string reference;
        std::string names;
        std::string expected;
    } rows[] = {
        {"Bag", "", kAlike},
        {"Ordered", "", kApart},
        {"Bag", "z", kChangedAlike},
        {"Ordered", "z", kChangedApart},
    };
    for (const auto& row : rows) {
        for (const char* b : {"Bag", "Ordered"}) {
            for (const char* c : {"Bag", "Ordered"}) {
                EXPECT_EQ(row.expected, Differences({Names(row.reference, row.names), Names(b, "xy"), Names(c, "yx")}))
                    << row.reference << " " << row.names << " " << b << " " << c;
            }
        }
    }
}

}  // namespace
}  // namespace NORVZEL20
