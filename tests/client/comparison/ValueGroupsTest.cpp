#include "client/comparison/TValueGroups.h"

#include <gtest/gtest.h>

#include "client/inventory/HashValue.h"

namespace NORVZEL20 {
namespace {

using TType = TCIMValue::TCIMType;

class ValueGroupsTest : public ::testing::Test {
  protected:
    /// Groups the values, one of each inventory. Returns the inventories of each group.
    std::string Groups(const std::vector<TCIMValue>& values)
    {
        TValueDifference difference;
        TValueGroups groups(
            difference,
            [this](const TCIMValue& one, const TCIMValue& other) {
                ++fComparisons;
                return one == other;
            },
            &HashValue);
        for (std::size_t inventory = 0; inventory < values.size(); ++inventory) {
            groups.Get(values[inventory]).Add(inventory, 1);
        }
        std::string text;
        for (const TValueDifference::TGroup& group : difference.others) {
            text += "[";
            for (const std::size_t inventory : group.inventories) {
                text += " " + std::to_string(inventory);
            }
            text += " ]";
        }
        return text;
    }

    /// How many comparisons it takes to group that many values, each of them twice.
    std::size_t ComparisonsOf(int count)
    {
        std::vector<TCIMValue> values;
        for (int i = 0; i < 2 * count; ++i) {
            values.push_back(TCIMValue("value " + std::to_string(i % count)));
        }
        fComparisons = 0;
        Groups(values);
        return fComparisons;
    }

    static TCIMValue Bag(const std::vector<TCIMValue>& elements)
    {
        return TCIMValue(TType::kArrayString, static_cast<unsigned int>(elements.size()), elements).AsBag();
    }

    std::size_t fComparisons = 0;
};

TEST_F(ValueGroupsTest, AValueIsComparedWithFewOthersHoweverManyGroupsThereAre)
{
    const std::size_t few = ComparisonsOf(500);
    EXPECT_GE(few, 500U);
    EXPECT_LE(few, 550U);
    EXPECT_LE(ComparisonsOf(1000), 2 * few);
}

TEST_F(ValueGroupsTest, EqualValuesAreTogetherInTheOrderOfTheirComing)
{
    EXPECT_EQ("[ 0 2 ][ 1 ]", Groups({TCIMValue("a"), TCIMValue("b"), TCIMValue("a")}));
    EXPECT_EQ("[ 0 10 ][ 1 ][ 2 ][ 3 ][ 4 ][ 5 ][ 6 ][ 7 ][ 8 12 ][ 9 11 ]",
              Groups({TCIMValue(0), TCIMValue(1), TCIMValue(2), TCIMValue(3), TCIMValue(4), TCIMValue(5), TCIMValue(6),
                      TCIMValue(7), TCIMValue(8), TCIMValue(9), TCIMValue(0), TCIMValue(9), TCIMValue(8)}));
}

TEST_F(ValueGroupsTest, BagsAreEqualInAnyOrderAmongManyGroupsToo)
{
    std::vector<TCIMValue> values{Bag({TCIMValue("x"), TCIMValue("y")})};
    for (int i = 1; i < 9; ++i) {
        values.push_back(TCIMValue(i));
    }
    values.push_back(Bag({TCIMValue("y"), TCIMValue("x")}));
    EXPECT_EQ("[ 0 9 ][ 1 ][ 2 ][ 3 ][ 4 ][ 5 ][ 6 ][ 7 ][ 8 ]", Groups(values));
}

TEST_F(ValueGroupsTest, NullsOfTwoTypesAreApart)
{
    EXPECT_EQ("[ 0 2 ][ 1 ]",
              Groups({TCIMValue::Null(TType::kString), TCIMValue::Null(TType::kUint8), TCIMValue::Null(TType::kString)}));
}

}  // namespace
}  // namespace NORVZEL20
