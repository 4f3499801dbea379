#include "engine/TMapCursor.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <random>
#include <string>
#include <vector>

namespace NORVZEL20 {
namespace {

// A key that counts how often keys are compared.
class TCountedKey {
  public:
    TCountedKey(std::string text, std::size_t* count) : fText(std::move(text)), fCount(count) {}

    int compare(const TCountedKey& other) const
    {
        ++*fCount;
        return fText.compare(other.fText);
    }
    bool operator<(const TCountedKey& other) const { return compare(other) < 0; }
    const std::string& GetText() const { return fText; }

  private:
    std::string fText;
    std::size_t* fCount;
};

using TMap = std::map<TCountedKey, int>;

constexpr int kCount = 10000;
constexpr std::size_t kSearch = 18;  // comparisons of a search among so many entries, with some to spare

class MapCursorTest : public testing::Test {
  protected:
    TCountedKey Key(int number) { return TCountedKey(std::to_string(kCount + number), &fCompared); }

    static std::vector<int> Numbers(int step, int start = 0)
    {
        std::vector<int> numbers;
        for (int number = start; number < kCount; number += step) {
            numbers.push_back(number);
        }
        return numbers;
    }

    static std::vector<int> Shuffled(std::vector<int> numbers)
    {
        std::mt19937 random(1);
        std::shuffle(numbers.begin(), numbers.end(), random);
        return numbers;
    }

    void Fill(const std::vector<int>& numbers)
    {
        for (const int number : numbers) {
            fMap.emplace(Key(number), number);
        }
        fCompared = 0;
    }

    // Looks for the numbers one after the other, and compares each answer with that of the map. Returns the comparisons.
    std::size_t Find(const std::vector<int>& numbers)
    {
        fCompared = 0;
        std::size_t ofCursor = 0;
        TMapCursor<TMap> cursor(fMap);
        for (const int number : numbers) {
            const std::size_t before = fCompared;
            TMap::value_type* const found = cursor.Find(Key(number));
            ofCursor += fCompared - before;
            const auto expected = fMap.find(Key(number));
            EXPECT_EQ(expected == fMap.end() ? nullptr : &*expected, found) << number;
        }
        return ofCursor;
    }

    // Adds the numbers to an empty map. Returns the comparisons.
    std::size_t Add(const std::vector<int>& numbers)
    {
        fMap.clear();
        fCompared = 0;
        TMapCursor<TMap> cursor(fMap);
        for (const int number : numbers) {
            cursor.FindOrAdd(Key(number)).second = number;
        }
        const std::size_t ofCursor = fCompared;
        EXPECT_EQ(numbers.size(), fMap.size());
        for (const auto& [key, number] : fMap) {
            EXPECT_EQ(key.GetText(), std::to_string(kCount + number));
        }
        return ofCursor;
    }

    std::size_t fCompared = 0;
    TMap fMap;
};

TEST_F(MapCursorTest, NothingIsInAnEmptyMap)
{
    EXPECT_EQ(0u, Find({1, 2, 1}));
}

TEST_F(MapCursorTest, KeysInOrderAreFoundWithOneComparison)
{
    Fill(Numbers(1));
    EXPECT_EQ(std::size_t{kCount}, Find(Numbers(1)));
}

TEST_F(MapCursorTest, KeysInOrderThatAreNotThereCostTwo)
{
    Fill(Numbers(2));
    EXPECT_GE(3 * std::size_t{kCount} / 2, Find(Numbers(1)));
    fMap.clear();
    Fill(Numbers(1000));
    EXPECT_GE(2 * std::size_t{kCount}, Find(Numbers(1)));
}

TEST_F(MapCursorTest, EntriesThatAreLeftOutArePassed)
{
    Fill(Numbers(1));
    EXPECT_GE(std::size_t{kCount}, Find(Numbers(4)));
}

TEST_F(MapCursorTest, AGapIsSearchedOnce)
{
    Fill(Numbers(1));
    std::vector<int> ends = Numbers(1);
    ends.erase(ends.begin() + 100, ends.end() - 100);
    EXPECT_GE(200 + 2 * kSearch, Find(ends));
}

TEST_F(MapCursorTest, KeysBehindTheLastEntryCostOne)
{
    Fill({0, 1, 2});
    EXPECT_GE(std::size_t{kCount} + kSearch, Find(Numbers(1)));
}

TEST_F(MapCursorTest, AKeyThatIsRepeatedIsFoundAgain)
{
    Fill(Numbers(1));
    EXPECT_GE(6 * 2u, Find({0, 0, 0, 1, 1, 2}));
}

TEST_F(MapCursorTest, KeysInAnyOtherOrderAreSearchedAfterOneComparison)
{
    Fill(Numbers(1));
    EXPECT_GE((kSearch + 1) * kCount, Find(Shuffled(Numbers(1))));
    fMap.clear();
    Fill(Numbers(2));
    EXPECT_GE((kSearch + 1) * kCount, Find(Shuffled(Numbers(1))));
    std::vector<int> backwards = Numbers(1);
    std::reverse(backwards.begin(), backwards.end());
    EXPECT_GE((kSearch + 1) * kCount, Find(backwards));
}

TEST_F(MapCursorTest, KeysInOrderAreAddedWithoutASearch)
{
    EXPECT_GE(3 * std::size_t{kCount}, Add(Numbers(1)));
}

TEST_F(MapCursorTest, KeysInAnyOtherOrderAreAddedWithOne)
{
    EXPECT_GE((kSearch + 4) * kCount, Add(Shuffled(Numbers(1))));
}

TEST_F(MapCursorTest, AddingAKeyThatIsThereReturnsItsEntry)
{
    TMapCursor<TMap> cursor(fMap);
    cursor.FindOrAdd(Key(1)).second = 10;
    cursor.FindOrAdd(Key(0)).second = 20;
    EXPECT_EQ(10, cursor.FindOrAdd(Key(1)).second);
    EXPECT_EQ(20, cursor.FindOrAdd(Key(0)).second);
    EXPECT_EQ(2u, fMap.size());
}

TEST_F(MapCursorTest, EntriesAddedWithoutTheCursorAreFound)
{
    Fill({0, 10});
    TMapCursor<TMap> cursor(fMap);
    EXPECT_NE(nullptr, cursor.Find(Key(0)));
    fMap.emplace(Key(5), 5);
    EXPECT_NE(nullptr, cursor.Find(Key(5)));
    fMap.emplace(Key(1), 1);
    EXPECT_NE(nullptr, cursor.Find(Key(1)));
    EXPECT_NE(nullptr, cursor.Find(Key(10)));
}

}  // namespace
}  // namespace NORVZEL20
