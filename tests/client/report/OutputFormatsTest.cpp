#include "client/report/OutputFormats.h"

#include <gtest/gtest.h>

#include <stdexcept>

namespace NORVZEL20 {
namespace {

TEST(OutputFormats, HaveNamesInTheOrderOfMessages)
{
    EXPECT_EQ((std::vector<std::string>{"text", "json", "ndjson", "cimxml", "csv", "markdown", "html"}), ReportFormatNames());
    EXPECT_EQ((std::vector<std::string>{"text", "json", "ndjson", "cimxml"}), ListingFormatNames());
    EXPECT_EQ((std::vector<std::string>{"text", "json"}), NoiseFormatNames());
    EXPECT_EQ(EOutputFormat::kText, OutputFormatOf("text"));
    EXPECT_EQ(EOutputFormat::kJson, OutputFormatOf("json"));
    EXPECT_EQ(EOutputFormat::kNdjson, OutputFormatOf("ndjson"));
    EXPECT_EQ(EOutputFormat::kCimXml, OutputFormatOf("cimxml"));
    EXPECT_EQ(EOutputFormat::kCsv, OutputFormatOf("csv"));
    EXPECT_EQ(EOutputFormat::kMarkdown, OutputFormatOf("markdown"));
    EXPECT_EQ(EOutputFormat::kHtml, OutputFormatOf("html"));
}

TEST(OutputFormats, OtherNamesAreRefused)
{
    for (const char* const name : {"", "JSON", "jso", "text "}) {
        EXPECT_THROW(OutputFormatOf(name), std::out_of_range) << name;
    }
}

}  // namespace
}  // namespace NORVZEL20
