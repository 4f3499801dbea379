#include "client/report/OutputFormats.h"

#include <stdexcept>

namespace NORVZEL20 {

namespace {

struct TFormatName {
    const char* name;
    EOutputFormat format;
    bool isForListings;
    bool isForNoise;
};

const TFormatName kFormats[] = {
    {"text", EOutputFormat::kText, true, true},      {"json", EOutputFormat::kJson, true, true},
    {"ndjson", EOutputFormat::kNdjson, true, false}, {"cimxml", EOutputFormat::kCimXml, true, false},
    {"csv", EOutputFormat::kCsv, false, false},      {"markdown", EOutputFormat::kMarkdown, false, false},
    {"html", EOutputFormat::kHtml, false, false}};

std::vector<std::string> NamesFor(bool TFormatName::*isFor)
{
    std::vector<std::string> names;
    for (const TFormatName& format : kFormats) {
        if (format.*isFor) {
            names.emplace_back(format.name);
        }
    }
    return names;
}

}  // namespace

std::vector<std::string> ReportFormatNames()
{
    std::vector<std::string> names;
    for (const TFormatName& format : kFormats) {
        names.emplace_back(format.name);
    }
    return names;
}

std::vector<std::string> ListingFormatNames()
{
    return NamesFor(&TFormatName::isForListings);
}

std::vector<std::string> NoiseFormatNames()
{
    return NamesFor(&TFormatName::isForNoise);
}

EOutputFormat OutputFormatOf(const std::string& name)
{
    for (const TFormatName& format : kFormats) {
        if (name == format.name) {
            return format.format;
        }
    }
    throw std::out_of_range("no output format is called " + name);
}

}  // namespace NORVZEL20
