#include "client/text/MatchesWildcards.h"

#include <gtest/gtest.h>

#include <string>

namespace NORVZEL20 {
namespace {

/// The simplest reading of a pattern: character by character, with every length for each star.
bool MatchesByTrial(const std::string& pattern, const std::string& name)
{
    if (pattern.empty()) {
        return name.empty();
    }
    if (pattern.front() == '*') {
        return MatchesByTrial(pattern.substr(1), name) || (!name.empty() && MatchesByTrial(pattern, name.substr(1)));
    }
    return !name.empty() && (pattern.front() == '?' || pattern.front() == name.front()) &&
           MatchesByTrial(pattern.substr(1), name.substr(1));
}

/// The texts of up to that length over an alphabet.
std::vector<std::string> AllTexts(const std::string& alphabet, std::size_t longest)
{
    std::vector<std::string> texts{""};
    for (std::size_t i = 0; i < texts.size(); ++i) {
        for (std::size_t c = 0; texts[i].size() < longest && c < alphabet.size(); ++c) {
            texts.push_back(texts[i] + alphabet[c]);
        }
    }
    return texts;
}

TEST(MatchesWildcards, AgreesWithTrialOfAllLengths)
{
    std::size_t matches = 0;
    for (const std::string& pattern : AllTexts("ab*?", 5)) {
        for (const std::string& name : AllTexts("ab", 5)) {
            ASSERT_EQ(MatchesByTrial(pattern, name), MatchesWildcards(pattern, name)) << pattern << " for " << name;
            matches += MatchesWildcards(pattern, name) ? 1 : 0;
        }
    }
    EXPECT_GT(matches, 1000U);
}

TEST(MatchesWildcards, DisregardsTheCaseOfLetters)
{
    EXPECT_TRUE(MatchesWildcards("kalmo_*.install?ate", "KALMO_Package.InstallDate"));
    EXPECT_FALSE(MatchesWildcards("kalmo_package", "KALMO_Packages"));
}

}  // namespace
}  // namespace NORVZEL20
