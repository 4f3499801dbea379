#include "embedded/store/THashIndex.h"

#include <gtest/gtest.h>

#include <map>
#include <random>

namespace NORVZEL20 {
namespace {

TEST(HashIndexTest, AnEmptyIndexFindsNothing)
{
    const THashIndex index;
    EXPECT_EQ(THashIndex::kNone, index.Find(0, [](std::uint32_t) { return true; }));
}

TEST(HashIndexTest, TheCallerChoosesAmongOrdinalsOfOneHash)
{
    THashIndex index;
    index.Add(7, 1);
    index.Add(7, 2);
    EXPECT_EQ(2U, index.Find(7, [](std::uint32_t ordinal) { return ordinal == 2; }));
    EXPECT_EQ(THashIndex::kNone, index.Find(8, [](std::uint32_t) { return true; }));
    index.Remove(7, 1);
    EXPECT_EQ(2U, index.Find(7, [](std::uint32_t) { return true; }));
    index.Remove(7, 3);
    index.Clear();
    EXPECT_EQ(THashIndex::kNone, index.Find(7, [](std::uint32_t) { return true; }));
}

TEST(HashIndexTest, AgreesWithAMapOverRandomChanges)
{
    std::mt19937 random(1);
    THashIndex index;
    std::map<std::uint32_t, std::uint32_t> hashes;  // by ordinal
    for (std::uint32_t step = 0; step < 50000; ++step) {
        const std::uint32_t ordinal = static_cast<std::uint32_t>(random() % 700);
        const auto at = hashes.find(ordinal);
        if (at == hashes.end()) {
            const std::uint32_t hash = static_cast<std::uint32_t>(random() % 300) << (random() % 3 * 8);
            index.Add(hash, ordinal);
            hashes[ordinal] = hash;
        } else {
            index.Remove(at->second, ordinal);
            hashes.erase(at);
        }
        const std::uint32_t wanted = static_cast<std::uint32_t>(random() % 700);
        const auto expected = hashes.find(wanted);
        const std::uint32_t hash = expected == hashes.end() ? 0 : expected->second;
        ASSERT_EQ(expected == hashes.end() ? THashIndex::kNone : wanted,
                  index.Find(hash, [wanted](std::uint32_t other) { return other == wanted; }));
    }
}

}  // namespace
}  // namespace NORVZEL20
