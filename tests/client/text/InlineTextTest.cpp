#include "client/text/InlineText.h"

#include <gtest/gtest.h>

namespace NORVZEL20 {
namespace {

TEST(InlineTextTest, QuotesWhatALineCouldSayItself)
{
    const struct {
        const char* text;
        const char* shown;
    } rows[] = {
        {"1:9.18.49-1~deb12u1", "1:9.18.49-1~deb12u1"},
        {"net.ipv4.ip_forward", "net.ipv4.ip_forward"},
        {"a plain text", "a plain text"},
        {"a, b", "\"a, b\""},
        {"a;b", "\"a;b\""},
        {"x=1", "\"x=1\""},
        {"2: p2", "\"2: p2\""},
        {"name:", "\"name:\""},
        {"x and 3 others", "\"x and 3 others\""},
        {"4   ... 9 more", "\"4   ... 9 more\""},
        {"(any instance)", "\"(any instance)\""},
        {"-noexec", "\"-noexec\""},
        {"+1", "\"+1\""},
        {"NULL", "\"NULL\""},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.shown, InlineText(TCIMValue(std::string(row.text))));
    }
    EXPECT_EQ("NULL", InlineText(TCIMValue::Null(TCIMValue::TCIMType::kString)));
    EXPECT_EQ("-5", InlineText(TCIMValue(static_cast<std::int32_t>(-5))));
}

}  // namespace
}  // namespace NORVZEL20
