#include "client/text/NearestWord.h"

#include <algorithm>

namespace NORVZEL20 {

namespace {

// The number of slips between two words, as the optimal string alignment counts them. Row i, column j of the table holds the
// number for the first i characters of one and the first j of the other.
std::size_t CountSlips(const std::string& a, const std::string& b)
{
    std::vector<std::vector<std::size_t>> table(a.size() + 1, std::vector<std::size_t>(b.size() + 1));
    for (std::size_t i = 0; i <= a.size(); ++i) {
        for (std::size_t j = 0; j <= b.size(); ++j) {
            if (i == 0 || j == 0) {
                table[i][j] = i + j;
                continue;
            }
            const std::size_t replaced = table[i - 1][j - 1] + (a[i - 1] == b[j - 1] ? 0 : 1);
            table[i][j] = std::min({table[i - 1][j] + 1, table[i][j - 1] + 1, replaced});
            if (i > 1 && j > 1 && a[i - 1] == b[j - 2] && a[i - 2] == b[j - 1]) {
                table[i][j] = std::min(table[i][j], table[i - 2][j - 2] + 1);
            }
        }
    }
    return table[a.size()][b.size()];
}

std::size_t CountWithoutDashes(const std::string& word)
{
    const std::size_t first = word.find_first_not_of('-');
    return first == std::string::npos ? 0 : word.size() - first;
}

}  // namespace

std::string NearestWord(const std::string& typed, const std::vector<std::string>& words)
{
    // Longer texts are near no word, and the table for them would be large.
    const std::size_t longest = 40;
    if (CountWithoutDashes(typed) < 2 || typed.size() > longest) {
        return std::string();
    }
    std::string nearest;
    std::size_t fewest = longest;
    for (const std::string& word : words) {
        if (word.compare(0, typed.size(), typed) == 0) {
            return word;
        }
        const std::size_t slips = CountSlips(typed, word);
        if (slips <= CountWithoutDashes(word) / 3 && slips < fewest) {
            nearest = word;
            fewest = slips;
        }
    }
    return nearest;
}

}  // namespace NORVZEL20
