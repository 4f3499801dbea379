#include "client/findings/TPresencePlaces.h"

#include <gtest/gtest.h>

namespace NORVZEL20 {
namespace {

/// Groups instances that came or went.
class PresencePlacesTest : public ::testing::Test {
  protected:
    static TDifference Presence(TDifference::EKind kind, std::vector<std::size_t> inventories)
    {
        TDifference difference;
        difference.kind = kind;
        difference.inventories = std::move(inventories);
        return difference;
    }

    /// The inventories that are the digits 1 of the number in binary.
    static std::vector<std::size_t> Digits(std::size_t number)
    {
        std::vector<std::size_t> digits;
        for (std::size_t digit = 0; number >> digit > 0; ++digit) {
            if ((number >> digit & 1) == 1) {
                digits.push_back(digit);
            }
        }
        return digits;
    }

    /// How many comparisons of sets it takes to group instances that come in so many sets of inventories.
    static std::size_t ComparisonsOf(std::size_t sets)
    {
        std::size_t comparisons = 0;
        const std::function<bool(const std::vector<std::size_t>&, const std::vector<std::size_t>&)> less =
            [&comparisons](const std::vector<std::size_t>& one, const std::vector<std::size_t>& other) {
                ++comparisons;
                return one < other;
            };
        TPresencePlaces places(less);
        for (std::size_t set = 1; set <= sets; ++set) {
            EXPECT_TRUE(places.Add(Presence(TDifference::kOnlyInReference, Digits(set))).second);
        }
        return comparisons;
    }
};

TEST_F(PresencePlacesTest, TheSameKindInTheSameInventoriesIsOneGroup)
{
    TPresencePlaces<> places;
    EXPECT_EQ(std::make_pair(std::size_t{0}, true), places.Add(Presence(TDifference::kOnlyInReference, {1, 2})));
    EXPECT_EQ(std::make_pair(std::size_t{1}, true), places.Add(Presence(TDifference::kOnlyInOthers, {1, 2})));
    EXPECT_EQ(std::make_pair(std::size_t{2}, true), places.Add(Presence(TDifference::kOnlyInReference, {1})));
    EXPECT_EQ(std::make_pair(std::size_t{0}, false), places.Add(Presence(TDifference::kOnlyInReference, {1, 2})));
    EXPECT_EQ(std::make_pair(std::size_t{1}, false), places.Add(Presence(TDifference::kOnlyInOthers, {1, 2})));
}

TEST_F(PresencePlacesTest, TwiceAsManySetsTakeLittleMoreThanTwiceTheComparisons)
{
    const std::size_t few = ComparisonsOf(4096);
    EXPECT_LE(std::size_t{4096}, few);
    EXPECT_GE(few * 5 / 2, ComparisonsOf(8192));
}

}  // namespace
}  // namespace NORVZEL20
