#include <gtest/gtest.h>

#include <string_view>
#include <vector>

#include "embedded/value/TUtf8.h"

namespace NORVZEL20 {
namespace {

struct TUtf8Row {
    std::string_view text;
    char32_t code;
    std::size_t length;
    const char* kind;
};

void ExpectFirst(const std::vector<TUtf8Row>& rows)
{
    for (const TUtf8Row& row : rows) {
        const TUtf8::TCharacter character = TUtf8::Decode(row.text);
        const char* const kind = character.IsOverlong() ? "overlong" : (character.IsScalar() ? "good" : "no scalar");
        EXPECT_EQ(row.code, character.code) << row.text;
        EXPECT_EQ(row.length, character.length) << row.text;
        EXPECT_STREQ(row.kind, kind) << row.text;
    }
}

TEST(Utf8Test, ATextBeginsWithItsCharacter)
{
    ExpectFirst({
        {std::string_view("\0", 1), 0, 1, "good"},
        {"a", 'a', 1, "good"},
        {"\x7F\x80", 0x7F, 1, "good"},
        {"\xC2\x80", 0x80, 2, "good"},
        {"\xDF\xBF", 0x7FF, 2, "good"},
        {"\xE0\xA0\x80", 0x800, 3, "good"},
        {"\xED\x9F\xBF", 0xD7FF, 3, "good"},
        {"\xEE\x80\x80", 0xE000, 3, "good"},
        {"\xEF\xBF\xBFz", 0xFFFF, 3, "good"},
        {"\xF0\x90\x80\x80", 0x10000, 4, "good"},
        {"\xF4\x8F\xBF\xBF", 0x10FFFF, 4, "good"},
        {"\xE0\x80\x8A", '\n', 3, "overlong"},
        {"\xE0\x9F\xBF", 0x7FF, 3, "overlong"},
        {"\xF0\x8F\xBF\xBF", 0xFFFF, 4, "overlong"},
        {"\xED\xA0\x80", 0xD800, 3, "no scalar"},
        {"\xED\xBF\xBF", 0xDFFF, 3, "no scalar"},
        {"\xF4\x90\x80\x80", 0x110000, 4, "no scalar"},
    });
}

TEST(Utf8Test, WhatIsNoCharacterIsOneByteWithoutALength)
{
    ExpectFirst({
        {"\x80", 0x80, 0, "good"},
        {"\xBF\xBF", 0xBF, 0, "good"},
        {"\xC0\x80", 0xC0, 0, "good"},
        {"\xC1\xBF", 0xC1, 0, "good"},
        {"\xF5\x80\x80\x80", 0xF5, 0, "good"},
        {"\xFF", 0xFF, 0, "good"},
        {"\xC3", 0xC3, 0, "good"},
        {std::string_view("\xC3\xA4", 1), 0xC3, 0, "good"},
        {"\xC3(", 0xC3, 0, "good"},
        {"\xE2\x82", 0xE2, 0, "good"},
        {"\xE2\x28\xA1", 0xE2, 0, "good"},
        {"\xF0\x9F\x98", 0xF0, 0, "good"},
        {"\xF0\x9F\x98z", 0xF0, 0, "good"},
    });
}

TEST(Utf8Test, ACharacterIsValidIfTheStandardAllowsIt)
{
    for (const char* const valid : {"a", "\xC2\x80", "\xED\x9F\xBF", "\xEF\xBF\xBF", "\xF4\x8F\xBF\xBF"}) {
        EXPECT_TRUE(TUtf8::Decode(valid).IsValid()) << valid;
    }
    for (const char* const invalid : {"\x80", "\xFF", "\xC3", "\xC3(", "\xE0\x80\xAF", "\xED\xA0\x80", "\xF4\x90\x80\x80"}) {
        EXPECT_FALSE(TUtf8::Decode(invalid).IsValid()) << invalid;
    }
}

TEST(Utf8Test, TheFirstInvalidByteIsFound)
{
    const struct {
        std::string_view text;
        std::size_t place;
    } rows[] = {
        {"", 0},     {"abc", 3},          {std::string_view("a\0b", 3), 3}, {"f\xC3\xBCr", 4},         {"f\xFCr", 1},
        {"\xFC", 0}, {"\xC3\xBC\xC3", 2}, {"ab\xE0\x80\xAFz", 2},           {"ab\xED\xA0\x80\xFF", 2},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.place, TUtf8::FindInvalid(row.text)) << row.text;
    }
}

TEST(Utf8Test, EveryCodeComesBackFromItsShortestForm)
{
    for (char32_t code = 0; code <= 0x10FFFF; ++code) {
        std::string text;
        TUtf8::Append(text, code);
        const TUtf8::TCharacter character = TUtf8::Decode(text);
        ASSERT_EQ(code, character.code);
        ASSERT_EQ(text.size(), character.length);
        ASSERT_FALSE(character.IsOverlong()) << code;
        ASSERT_EQ(code < 0xD800 || code > 0xDFFF, character.IsScalar()) << code;
    }
}

TEST(Utf8Test, AppendingKeepsWhatIsThere)
{
    std::string text = "5 ";
    TUtf8::Append(text, U'\u20AC');
    EXPECT_EQ("5 \xE2\x82\xAC", text);
}

TEST(Utf8Test, AShortenedTextDoesNotEndWithinACharacter)
{
    const struct {
        std::string_view text;
        std::size_t limit;
        std::string_view start;
    } rows[] = {
        {"", 0, ""},
        {"abc", 3, "abc"},
        {"abc", 2, "ab"},
        {"ab\xC3\xA4", 4, "ab\xC3\xA4"},
        {"ab\xC3\xA4z", 3, "ab"},
        {"ab\xC3\xA4z", 4, "ab"},
        {"\xC3\xA4\xE2\x82\xACz", 4, "\xC3\xA4"},
        {"\xF0\x9F\x98\x80z", 2, ""},
        {"\x80\x80\x80\x80\x80\x80", 5, ""},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.start, TUtf8::Shorten(row.text, row.limit)) << row.text << " " << row.limit;
    }
}

}  // namespace
}  // namespace NORVZEL20
