#include "client/text/QuoteForShell.h"

#include <algorithm>
#include <boost/algorithm/string/replace.hpp>

namespace NORVZEL20 {

namespace {

// What no shell treats specially, wherever it stands. Bytes above ASCII belong to letters.
bool IsPlainInShell(char c)
{
    const char plain[] = "_-./,:+@%";
    const bool isLetter = (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || static_cast<unsigned char>(c) > 0x7f;
    return isLetter || (c >= '0' && c <= '9') || std::string(plain).find(c) != std::string::npos;
}

}  // namespace

std::string QuoteForShell(const std::string& word)
{
    if (!word.empty() && std::all_of(word.begin(), word.end(), IsPlainInShell)) {
        return word;
    }
    return "'" + boost::algorithm::replace_all_copy(word, "'", "'\\''") + "'";
}

}  // namespace NORVZEL20
