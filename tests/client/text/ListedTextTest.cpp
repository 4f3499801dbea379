#include "client/text/ListedText.h"

#include <gtest/gtest.h>

namespace NORVZEL20 {
namespace {

using TType = TCIMValue::TCIMType;

TCIMValue Array(const std::vector<std::string>& texts)
{
    const std::vector<TCIMValue> elements(texts.begin(), texts.end());
    return TCIMValue(TType(TType::kArrayString), static_cast<unsigned int>(elements.size()), elements);
}

TEST(ListedTextTest, QuotesWhatCouldBeMistaken)
{
    const struct {
        TCIMValue value;
        const char* text;
    } rows[] = {
        {TCIMValue(std::string("plain text")), "plain text"},
        {TCIMValue(std::string("a, b")), "\"a, b\""},
        {TCIMValue(std::string("{a}")), "\"{a}\""},
        {TCIMValue(std::string()), "\"\""},
        {TCIMValue::Null(TType::kString), "NULL"},
        {Array({"mallory", "sudo"}), "{mallory, sudo}"},
        {Array({"a, b", "NULL", ""}), "{\"a, b\", \"NULL\", \"\"}"},
        {Array({}), "{}"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.text, ListedText(row.value));
    }
}

}  // namespace
}  // namespace NORVZEL20
