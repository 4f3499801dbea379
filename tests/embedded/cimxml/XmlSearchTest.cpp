// Both forms of the tokenizer's searches against the plainest loop.
#include <gtest/gtest.h>

#include <algorithm>
#include <random>
#include <string>
#include <string_view>

#include "embedded/cimxml/TPlainXmlSearch.h"
#include "embedded/cimxml/TXmlSearch.h"

namespace NORVZEL20 {
namespace {

/// A text of mostly plain characters with room behind it.
std::string MakeText(std::mt19937& random, std::size_t length)
{
    constexpr std::string_view kRare("<&]\"\n\r\t\0\x01\x1F\x7F\x80\xFF", 13);
    std::string text;
    while (text.size() < length) {
        text += random() % 8 == 0 ? kRare[random() % kRare.size()] : static_cast<char>(' ' + random() % 0x5F);
    }
    return text + std::string(TXmlSearch::kReadsBeyond + 1, '\0');
}

std::size_t FindSlowly(const std::string& text, std::size_t from, char delimiter)
{
    const auto isPlain = [delimiter](char c) {
        return c >= ' ' && static_cast<unsigned char>(c) < 0x80U && c != '<' && c != '&' && c != delimiter;
    };
    while (isPlain(text[from])) {
        ++from;
    }
    return from;
}

std::size_t CountSlowly(const std::string& text, std::size_t from, std::size_t to)
{
    std::size_t count = 0;
    for (; from < to; ++from) {
        const bool isPair = text[from] == '\r' && text[from + 1] == '\n';
        count += (text[from] == '\r' || text[from] == '\n') && !isPair ? 1 : 0;
    }
    return count;
}

template <class TSearch>
class XmlSearchTest : public testing::Test {};

// If the compiler may not use SSE2, both are the same.
using TSearches = testing::Types<TPlainXmlSearch, TXmlSearch>;
TYPED_TEST_SUITE(XmlSearchTest, TSearches);

TYPED_TEST(XmlSearchTest, TheFirstSpecialByteIsFoundFromEverywhere)
{
    std::mt19937 random(1);
    for (std::size_t length = 0; length < 100; ++length) {
        const std::string text = MakeText(random, length);
        for (std::size_t from = 0; from <= length; ++from) {
            for (const char delimiter : {']', '"', '\'', '-'}) {
                const char* const found = TypeParam::FindSpecial(text.data() + from, delimiter);
                EXPECT_EQ(FindSlowly(text, from, delimiter), static_cast<std::size_t>(found - text.data())) << text;
            }
        }
    }
}

TYPED_TEST(XmlSearchTest, EqualBytesAreTheSameAndOneOtherByteIsNot)
{
    std::mt19937 random(2);
    for (std::size_t length = 1; length < 70; ++length) {
        const std::string text = MakeText(random, length);
        std::string other = text;
        other[length] = 'x';  // behind the bytes that count
        EXPECT_TRUE(TypeParam::AreSame(text.data(), other.data(), length));
        for (std::size_t at = 0; at < length; ++at) {
            other = text;
            ++other[at];
            EXPECT_FALSE(TypeParam::AreSame(text.data(), other.data(), length)) << at;
        }
    }
    EXPECT_TRUE(TypeParam::AreSame(std::string(TXmlSearch::kReadsBeyond, 'a').data(),
                                   std::string(TXmlSearch::kReadsBeyond, 'b').data(), 0));
}

TYPED_TEST(XmlSearchTest, LineEndsAreCountedAndPairsOnce)
{
    std::mt19937 random(3);
    for (std::size_t length = 0; length < 10000; length += 1 + length / 3) {
        std::string text = MakeText(random, length);
        for (std::size_t pair = 0; pair < length / 10; ++pair) {
            text.replace(random() % length, 2, "\r\n");
        }
        for (std::size_t from = 0; from <= std::min<std::size_t>(length, 20); ++from) {
            EXPECT_EQ(CountSlowly(text, from, length), TypeParam::CountLineEnds(text.data() + from, text.data() + length))
                << length;
        }
    }
    const std::string feeds(9000, '\n');
    EXPECT_EQ(8980u, TypeParam::CountLineEnds(feeds.data(), feeds.data() + 8980));
}

}  // namespace
}  // namespace NORVZEL20
