#include "client/text/DisplayText.h"

#include <gtest/gtest.h>

#include "host/TCIMReference.h"

namespace NORVZEL20 {
namespace {

TEST(EscapeForDisplay, LeavesOrdinaryTextAlone)
{
    EXPECT_EQ("Gr\u00fc\u00dfe, \u4e16\u754c \\ \" '", EscapeForDisplay("Gr\u00fc\u00dfe, \u4e16\u754c \\ \" '"));
}

TEST(EscapeForDisplay, ShowsWhatWouldActOnATerminal)
{
    const struct {
        std::string text;
        const char* shown;
    } rows[] = {
        {"a\nb", "a\\nb"},
        {"a\r\tb", "a\\r\\tb"},
        {"\x1b[31m", "\\x1b[31m"},
        {std::string("\0", 1), "\\x00"},
        {"\x7f", "\\x7f"},
        {"\xc2\x9b", "\\u009b"},  // the one-character form of ESC [
        {"\xe2\x80\xae"
         "abc",
         "\\u202eabc"},  // writes backwards
        {"\xff", "\\xff"},
        {"\xc3", "\\xc3"},
        {"\xc3(", "\\xc3("},
        {"\xe2\x82", "\\xe2\\x82"},
        {"\xe0\x80\x9b", "\\xe0\\x80\\x9b"},           // ESC, overlong
        {"\xed\xa0\x80", "\\xed\\xa0\\x80"},           // a surrogate
        {"\xf4\x90\x80\x80", "\\xf4\\x90\\x80\\x80"},  // above the last character
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.shown, EscapeForDisplay(row.text));
    }
}

TEST(EscapeForDisplay, ShowsWhatIsInvisibleOrLooksLikeABlank)
{
    const struct {
        const char* text;
        const char* shown;
    } rows[] = {
        {"a\u00a0b", "a\\u00a0b"},  // no-break space
        {"a\u202fb", "a\\u202fb"},  // narrow no-break space
        {"a\u2003b", "a\\u2003b"},  // em space
        {"a\u00adb", "a\\u00adb"},  // soft hyphen
        {"a\u200bb", "a\\u200bb"},  // zero width space
        {"a\u200db", "a\\u200db"},  // zero width joiner
        {"a\u2060b", "a\\u2060b"},  // word joiner
        {"a\ufeffb", "a\\ufeffb"},  // byte order mark
        {"a\u2010b", "a\u2010b"},   // hyphen
        {"a\u2070b", "a\u2070b"},   // superscript zero
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.shown, EscapeForDisplay(row.text));
    }
}

TEST(DisplayLabel, IsQuotedIfItCouldBeTakenForSeveral)
{
    const struct {
        const char* label;
        const char* shown;
    } rows[] = {
        {"web01", "web01"},
        {"old/web01.xml#2", "old/web01.xml#2"},
        {"caf\\xe9", "caf\\xe9"},
        {"a,b", "a,b"},
        {"a, b", "\"a, b\""},
        {"a and b", "\"a and b\""},
        {"web 01", "\"web 01\""},
        {"a,", "\"a,\""},
        {"a:", "\"a:\""},
        {"a.", "\"a.\""},
        {"\"a\"", "\"\\\"a\\\"\""},
        {"", "\"\""},
        {"all", "\"all\""},
        {"others", "\"others\""},
        {"ALL", "ALL"},
        {"allweb", "allweb"},
        {"web01..04", "\"web01..04\""},
        {"..1", "\"..1\""},
        {"../web01", "../web01"},
        {"../7", "../7"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.shown, DisplayLabel(row.label));
    }
}

TEST(DisplayValue, DistinguishesTextsThatLookAlike)
{
    const struct {
        TCIMValue value;
        const char* shown;
    } rows[] = {
        {TCIMValue("4.19"), "4.19"},
        {TCIMValue("two words"), "two words"},
        {TCIMValue(""), "\"\""},
        {TCIMValue("NULL"), "\"NULL\""},
        {TCIMValue(), "NULL"},
        {TCIMValue::Null(TCIMValue::TCIMType::kString), "NULL"},
        {TCIMValue(" web"), "\" web\""},
        {TCIMValue("web "), "\"web \""},
        {TCIMValue("a -> b"), "\"a -> b\""},
        {TCIMValue("a / b"), "\"a / b\""},
        {TCIMValue("C:\\x"), "\"C:\\\\x\""},
        {TCIMValue("say \"x\""), "\"say \\\"x\\\"\""},
        {TCIMValue("a\nb"), "\"a\\nb\""},
        {TCIMValue("a\u00a0b"), "\"a\\u00a0b\""},
        {TCIMValue(7u), "7"},
        {TCIMValue(true), "TRUE"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.shown, DisplayValue(row.value));
    }
}

TEST(DisplayValue, ShowsArraysInBraces)
{
    const std::vector<TCIMValue> elements = {TCIMValue("a"), TCIMValue("b\x1b")};
    EXPECT_EQ("{\"a\", \"b\\x1b\"}", DisplayValue(TCIMValue(TCIMValue::TCIMType::kArrayString, 2, elements)));
    EXPECT_EQ("{}", DisplayValue(TCIMValue(TCIMValue::TCIMType::kArrayString, 0, {})));
}

}  // namespace
}  // namespace NORVZEL20
