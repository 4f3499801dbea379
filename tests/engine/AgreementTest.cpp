#include <gtest/gtest.h>

#include <cstdlib>
#include <map>
#include <set>

#include "tests/engine/NaiveComparison.h"
#include "tests/engine/RandomSet.h"
#include "tests/engine/SetBuilding.h"

namespace NORVZEL20 {
namespace {

// The number of sets and the first seed. CIMDELTA_SETS and CIMDELTA_SEED change them, to repeat a single failure.
std::uint64_t FromEnvironment(const char* name, std::uint64_t otherwise)
{
    const char* text = std::getenv(name);
    return text ? std::strtoull(text, nullptr, 10) : otherwise;
}

class AgreementTest : public testing::TestWithParam<EHost> {
  protected:
    // The kinds of results that all sets together had.
    std::map<std::string, unsigned int> fSeen;

    void Note(const std::string& outcome)
    {
        for (const std::string mark : {"\n  1 ", "\n  2 ", "\n  4 ", " -> ", "status 3\n", "status 9\n", "status 15\n",
                                       "status 37\n", " 1 1", "[1 3", "=\"<INSTANCE ", "=\"C0.", "=\"2024022911****.******+030\"",
                                       "=\"00000001000000.000000:000\"", "='", "=-128", "=NaN"}) {
            fSeen[mark] += outcome.find(mark) != std::string::npos ? 1 : 0;
        }
    }
};

TEST_P(AgreementTest, PlugInAndNaiveComparisonLeaveTheSame)
{
    const std::uint64_t first = FromEnvironment("CIMDELTA_SEED", 1);
    const std::uint64_t count = FromEnvironment("CIMDELTA_SETS", 3000);
    const bool isStrict = GetParam() == EHost::kInmem;
    for (std::uint64_t seed = first; seed < first + count; ++seed) {
        TNaiveSet set = MakeRandomSet(seed, isStrict);
        set.areListsBags = isStrict;
        const std::string expected = CompareNaively(set);
        ASSERT_EQ(expected, CompareByPlugIn(set, GetParam())) << "seed " << seed << "\n" << RulesOf(set);
        Note(expected);
    }
    for (const auto& [mark, times] : fSeen) {
        EXPECT_TRUE(count < 3000 || times >= 10) << "only " << times << " sets with \"" << mark << "\"";
    }
}

INSTANTIATE_TEST_SUITE_P(Hosts, AgreementTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

TEST(RandomSetTest, TheSameSeedMakesTheSameSet)
{
    EXPECT_EQ(CompareNaively(MakeRandomSet(7, true)), CompareNaively(MakeRandomSet(7, true)));
    EXPECT_EQ(RulesOf(MakeRandomSet(7, false)), RulesOf(MakeRandomSet(7, false)));
    std::set<std::string> outcomes;
    for (std::uint64_t seed = 0; seed < 100; ++seed) {
        outcomes.insert(CompareNaively(MakeRandomSet(seed, true)));
    }
    EXPECT_LT(80u, outcomes.size());
}

}  // namespace
}  // namespace NORVZEL20
