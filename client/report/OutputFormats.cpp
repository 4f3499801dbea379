#include "client/report/OutputFormats.h"

#include <stdexcept>

namespace NORVZEL20 {

namespace {

const struct {
    const char* name;
    EOutputFormat format;
    bool isForListings;
} kFormats[] = {{"text", EOutputFormat::kText, true},     {"json", EOutputFormat::kJson, true},
                {"ndjson", EOutputFormat::kNdjson, true}, {"cimxml", EOutputFormat::kCimXml, true},
                {"csv", EOutputFormat::kCsv, false},      {"markdown", EOutputFormat::kMarkdown, false},
                {"html", EOutputFormat::kHtml, false}};

}  // namespace

std::vector<std::string> ReportFormatNames()
{
    std::vector<std::string> names;
    for (const auto& format : kFormats) {
        names.emplace_back(format.name);
    }
    return names;
}

std::vector<std::string> ListingFormatNames()
{
    std::vector<std::string> names;
    for (const auto& format : kFormats) {
        if (format.isForListings) {
            names.emplace_back(format.name);
        }
    }
    return names;
}

EOutputFormat OutputFormatOf(const std::string& name)
{
    for (const auto& format : kFormats) {
        if (name == format.name) {
            return format.format;
        }
    }
    throw std::out_of_range("no output format is called " + name);
}

}  // namespace NORVZEL20
