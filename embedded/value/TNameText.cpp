#include "embedded/value/TNameText.h"

#include <algorithm>

namespace NORVZEL20 {

std::string TNameText::ToLower(std::string_view name)
{
    std::string result(name);
    std::transform(result.begin(), result.end(), result.begin(), [](char c) { return ToLower(c); });
    return result;
}

bool TNameText::Equal(std::string_view a, std::string_view b) noexcept
{
    if (a.size() != b.size()) {
        return false;
    }
    // Most names come in the spelling of their declaration.
    if (HasSameSpelling(a, b)) {
        return true;
    }
    return std::equal(a.begin(), a.end(), b.begin(), [](char x, char y) { return ToLower(x) == ToLower(y); });
}

int TNameText::Compare(std::string_view a, std::string_view b) noexcept
{
    const std::size_t common = std::min(a.size(), b.size());
    std::size_t i = 0;
    // Names that are compared often begin alike, such as those of a vendor's classes.
    while (i + sizeof(std::uint64_t) <= common && Load<std::uint64_t>(a, i) == Load<std::uint64_t>(b, i)) {
        i += sizeof(std::uint64_t);
    }
    for (; i < common; ++i) {
        const int difference = static_cast<int>(static_cast<unsigned char>(ToLower(a[i]))) -
                               static_cast<int>(static_cast<unsigned char>(ToLower(b[i])));
        if (difference != 0) {
            return difference;
        }
    }
    return a.size() == b.size() ? 0 : (a.size() < b.size() ? -1 : 1);
}

std::uint32_t TNameText::Hash(std::string_view name) noexcept
{
    // FNV-1a suits short texts. The two halves are combined because the lower bits alone mix poorly.
    std::uint64_t hash = 0xcbf29ce484222325u;
    for (const char c : name) {
        hash = (hash ^ static_cast<unsigned char>(ToLower(c))) * 0x100000001b3u;
    }
    return static_cast<std::uint32_t>(hash ^ (hash >> 32));
}

}  // namespace NORVZEL20
