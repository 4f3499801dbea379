#include "client/report/OutputFormats.h"

#include <stdexcept>

namespace NORVZEL20 {

namespace {

const struct {
    const char* name;
    EOutputFormat format;
} kFormats[] = {{"text", EOutputFormat::kText},
                {"json", EOutputFormat::kJson},
                {"ndjson", EOutputFormat::kNdjson},
                {"cimxml", EOutputFormat::kCimXml}};

}  // namespace

std::vector<std::string> OutputFormatNames()
{
    std::vector<std::string> names;
    for (const auto& format : kFormats) {
        names.emplace_back(format.name);
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
