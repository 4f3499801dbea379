#include "client/text/NumberIn.h"

#include <gtest/gtest.h>

namespace NORVZEL20 {
namespace {

TEST(NumberInTest, OnlyAWholeTextIsANumber)
{
    const struct {
        const char* text;
        int base;
        std::optional<std::uint64_t> number;
    } rows[] = {
        {"0", 10, 0},
        {"007", 10, 7},
        {"18446744073709551615", 10, UINT64_MAX},
        {"18446744073709551616", 10, std::nullopt},
        {"fF", 16, 255},
        {"0x10", 16, std::nullopt},
        {"18", 8, std::nullopt},
        {"", 10, std::nullopt},
        {"-1", 10, std::nullopt},
        {"+1", 10, std::nullopt},
        {" 1", 10, std::nullopt},
        {"1 ", 10, std::nullopt},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.number, NumberIn(row.text, row.base)) << row.text;
    }
}

}  // namespace
}  // namespace NORVZEL20
