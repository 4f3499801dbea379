// Elements, attributes and names beyond any measure.
#include "tests/hostile/HostileRow.h"
#include "tests/hostile/TMemoryMeter.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kMegabyte = 1u << 20;

std::string Repeat(const std::string& unit, std::size_t times)
{
    std::string text;
    text.reserve(unit.size() * times);
    for (std::size_t i = 0; i < times; ++i)
        text += unit;
    return text;
}

std::string Attributes(std::size_t count)
{
    std::string text;
    for (std::size_t i = 0; i < count; ++i)
        text += " a" + std::to_string(i) + "=''";
    return text;
}

}  // namespace

TEST(NestingTest, AMillionNestedElementsAreRefused)
{
    const THostileDocument document{"", Repeat("<a>", 1000000) + Repeat("</a>", 1000000)};
    ExpectOutcomes({Refused("nested", document, 1, "elements are nested too deeply", "1:0")});
}

TEST(NestingTest, TenThousandAttributesAreRefused)
{
    ExpectOutcomes({Refused("different ones", {"", "<a" + Attributes(10000) + "/>"}, 1, "too many attributes", "1:0"),
                    Refused("one twice", {"", "<a b='' c='' b=''/>"}, 1, "duplicate attribute", "1:0")});
}

/// A long name is one that nobody knows, as any other.
TEST(NestingTest, NamesOfAMegabyteAreNames)
{
    const std::string name(kMegabyte, 'n');
    ExpectOutcomes({{"element", {"", "<" + name + "/>"}, "2 elements, text ''", "", ""},
                    {"attribute", {"", "<a " + name + "=''/>"}, "2 elements, text ''", "", ""}});
}

TEST(NestingTest, TagsBeyondTheLimitAreRefused)
{
    const std::string name(20 * kMegabyte, 'n');
    ExpectOutcomes({Refused("a name", {"", "<" + name + "/>"}, 1, "a tag is too long", "1:0"),
                    Refused("a value", {"", "<a b='" + name + "'/>"}, 1, "a tag is too long", "1:0"),
                    Refused("a comment", {"", "<!--" + name + "-->"}, 1, "a tag is too long", "1:0")});
}

}  // namespace NORVZEL20
