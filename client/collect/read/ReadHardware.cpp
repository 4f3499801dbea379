// What the kernel says of processors and memory.
//
//   cpuinfo    a paragraph for each logical processor, with lines "name : value"; those of one socket have one "physical id".
//              Machines without such a line (ARM among others) count as one socket
//   meminfo    lines "MemTotal:       16303428 kB"
//   swaps      a heading, then lines with file, type, size, used size (both in KiB) and priority
#include "client/collect/read/ReadHardware.h"

#include <algorithm>
#include <map>
#include <set>

#include "client/collect/read/TTextLines.h"
#include "client/collect/read/TextPieces.h"
#include "client/text/NumberIn.h"

namespace NORVZEL20 {

namespace {

constexpr std::uint64_t kKibibyte = 1024;

using THardwareValues = std::map<std::string, std::string, std::less<>>;

std::string ValueOf(const THardwareValues& values, std::initializer_list<const char*> names)
{
    for (const char* const name : names) {
        const auto found = values.find(name);
        if (found != values.end()) {
            return found->second;
        }
    }
    return std::string();
}

// A line "name : value".
void TakeValue(THardwareValues& values, std::string_view line)
{
    const std::size_t colon = line.find(':');
    if (colon != std::string_view::npos) {
        values.emplace(Trimmed(line.substr(0, colon)), Trimmed(line.substr(colon + 1)));
    }
}

struct TProcessorSocket {
    THardwareValues values;
    std::uint64_t logical = 0;
    std::set<std::string> cores;
};

std::vector<std::string> SortedWords(std::string_view text)
{
    std::vector<std::string> words;
    for (const std::string_view word : SplitAtBlanks(text)) {
        words.emplace_back(word);
    }
    std::sort(words.begin(), words.end());
    return words;
}

TFacts FactsOf(const std::string& number, const TProcessorSocket& socket)
{
    const THardwareValues& values = socket.values;
    TFacts facts("KALMO_Processor");
    facts.Key("DeviceID", number)
        .Text("Manufacturer", ValueOf(values, {"vendor_id", "CPU implementer"}))
        .Text("Model", ValueOf(values, {"model name", "cpu", "CPU part", "cpu model"}))
        .Text("Family", ValueOf(values, {"cpu family", "CPU architecture"}))
        .Text("Stepping", ValueOf(values, {"stepping", "CPU revision", "revision"}))
        .Text("Microcode", ValueOf(values, {"microcode"}))
        .Number("NumberOfLogicalProcessors", socket.logical)
        .Texts("Flags", SortedWords(ValueOf(values, {"flags", "Features"})));
    if (!socket.cores.empty()) {
        facts.Number("NumberOfCores", socket.cores.size());
    }
    return facts;
}

}  // namespace

std::vector<TFacts> ReadProcessors(std::string_view text)
{
    std::map<std::string, TProcessorSocket> sockets;
    THardwareValues values;
    const auto endParagraph = [&] {
        if (values.count("processor") > 0) {
            TProcessorSocket& socket = sockets[values.count("physical id") > 0 ? values["physical id"] : "0"];
            ++socket.logical;
            if (values.count("core id") > 0) {
                socket.cores.insert(values["core id"]);
            }
            socket.values.merge(values);
        }
        values.clear();
    };
    TTextLines lines(text);
    while (lines.Next()) {
        if (Trimmed(lines.GetLine()).empty()) {
            endParagraph();
        }
        TakeValue(values, lines.GetLine());
    }
    endParagraph();
    std::vector<TFacts> facts;
    for (const auto& [number, socket] : sockets) {
        facts.push_back(FactsOf(number, socket));
    }
    return facts;
}

std::optional<TFacts> ReadMemory(std::string_view text)
{
    THardwareValues values;
    TTextLines lines(text);
    while (lines.Next()) {
        TakeValue(values, lines.GetLine());
    }
    TFacts facts("KALMO_Memory");
    facts.Key("DeviceID", "memory");
    const auto add = [&](const char* property, const char* name, std::uint64_t unit) {
        const std::vector<std::string_view> words = SplitAtBlanks(values[name]);
        const std::optional<std::uint64_t> number = words.empty() ? std::nullopt : NumberIn(words[0]);
        if (number) {
            facts.Number(property, *number * unit);
        }
        return number.has_value();
    };
    if (!add("TotalSize", "MemTotal", kKibibyte)) {
        return std::nullopt;
    }
    add("AvailableSize", "MemAvailable", kKibibyte);
    add("HugePages", "HugePages_Total", 1);
    add("HugePageSize", "Hugepagesize", kKibibyte);
    return facts;
}

std::vector<TFacts> ReadSwapAreas(std::string_view text, TReadFaults& faults)
{
    std::vector<TFacts> areas;
    TTextLines lines(text);
    lines.Next();  // the heading
    while (lines.Next()) {
        const std::vector<std::string_view> fields = SplitAtBlanks(lines.GetLine());
        const bool isNegative = fields.size() == 5 && StartsWith(fields[4], "-");
        const auto number = [&](std::size_t field, std::size_t skipped = 0) {
            return fields.size() == 5 ? NumberIn(fields[field].substr(skipped)) : std::nullopt;
        };
        const std::optional<std::uint64_t> total = number(2);
        const std::optional<std::uint64_t> used = number(3);
        const std::optional<std::uint64_t> priority = number(4, isNegative ? 1 : 0);
        if (!total || !used || !priority || *priority > INT32_MAX) {
            faults.Add(lines.GetNumber(), "found " + Quoted(lines.GetLine()) + ", expected file, type, two sizes and a priority");
            continue;
        }
        const std::int64_t value = static_cast<std::int64_t>(*priority);
        areas.push_back(TFacts("KALMO_SwapArea")
                            .Key("DeviceID", fields[0])
                            .Text("Type", fields[1])
                            .Number("TotalSize", *total * kKibibyte)
                            .Number("UsedSize", *used * kKibibyte)
                            .Signed("Priority", isNegative ? -value : value));
    }
    return areas;
}

}  // namespace NORVZEL20
