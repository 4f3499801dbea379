// Answers the question of `cimdelta compare -o ndjson` in the plainest way: reads every inventory with Expat into tables of text,
// joins them by a hash of the keys, and writes one line of JSON for each instance that is missing or new and each value that
// differs.
//
// Prints what the steps took, and the number of differences, as one line of JSON. With a single inventory it only reads.

#include <unistd.h>

#include <CLI/CLI.hpp>
#include <cstdio>
#include <exception>
#include <fstream>
#include <iostream>
#include <string>
#include <unordered_map>
#include <vector>

#include "bench/TStopwatch.h"
#include "bench/peers/TFlatInventory.h"

namespace NORVZEL20 {
namespace {

void AppendText(std::string& json, const std::string& text)
{
    json.append(1, '"');
    for (const char letter : text) {
        if (letter == '"' || letter == '\\') {
            json.append(1, '\\').append(1, letter);
        } else if (static_cast<unsigned char>(letter) < 0x20) {
            char escape[8];
            std::snprintf(escape, sizeof escape, "\\u%04x", static_cast<unsigned int>(letter));
            json.append(escape);
        } else {
            json.append(1, letter);
        }
    }
    json.append(1, '"');
}

class TFlatComparison {
  public:
    TFlatComparison(const TFlatInventory& reference, std::ostream& out) : fReference(reference), fOut(out) {}

    void CompareWith(const TFlatInventory& other)
    {
        std::unordered_map<std::string, const TFlatRow*> rows;
        rows.reserve(other.Rows().size());
        for (const TFlatRow& row : other.Rows()) {
            rows.emplace(other.KeyText(row), &row);
        }
        for (const TFlatRow& row : fReference.Rows()) {
            const auto match = rows.find(fReference.KeyText(row));
            if (match == rows.end()) {
                Write("onlyInReference", fReference, row);
                continue;
            }
            CompareValues(row, other, *match->second);
            rows.erase(match);
        }
        for (const TFlatRow& row : other.Rows()) {
            if (rows.count(other.KeyText(row)) != 0) {
                Write("onlyInOther", other, row);
            }
        }
    }

    std::size_t Differences() const { return fDifferences; }

  private:
    void CompareValues(const TFlatRow& row, const TFlatInventory& other, const TFlatRow& match)
    {
        const std::vector<std::string>& names = fReference.Classes()[row.classNumber].properties;
        if (names != other.Classes()[match.classNumber].properties) {
            throw std::runtime_error("the inventories declare a class differently");
        }
        for (std::size_t place = 0; place < names.size(); ++place) {
            if (row.values[place] != match.values[place]) {
                std::string more = ",\"property\":\"" + names[place] + "\",\"reference\":";
                AppendText(more, row.values[place]);
                more.append(",\"other\":");
                AppendText(more, match.values[place]);
                Write("changed", fReference, row, more);
            }
        }
    }

    void Write(const char* kind, const TFlatInventory& inventory, const TFlatRow& row, const std::string& more = {})
    {
        const TFlatClass& type = inventory.Classes()[row.classNumber];
        std::string line = std::string("{\"kind\":\"") + kind + "\",\"class\":\"" + type.name + "\",\"keys\":{";
        for (const std::size_t key : type.keys) {
            line.append(line.back() == '{' ? "\"" : ",\"").append(type.properties[key]).append("\":");
            AppendText(line, row.values[key]);
        }
        fOut << line << '}' << more << "}\n";
        ++fDifferences;
    }

    const TFlatInventory& fReference;
    std::ostream& fOut;
    std::size_t fDifferences = 0;
};

void Run(const std::vector<std::string>& files, const std::string& output)
{
    const TStopwatch loading;
    const std::vector<TFlatInventory> inventories(files.begin(), files.end());
    std::printf("{\"load_cpu_ms\": %.3f, \"load_wall_ms\": %.3f", loading.CpuMilliseconds(), loading.WallMilliseconds());
    if (inventories.size() > 1) {
        const TStopwatch comparing;
        std::ofstream out(output, std::ios::binary);
        TFlatComparison comparison(inventories.front(), out);
        for (std::size_t other = 1; other < inventories.size(); ++other) {
            comparison.CompareWith(inventories[other]);
        }
        if (!out.flush()) {
            throw std::runtime_error(output + ": cannot be written");
        }
        std::printf(", \"compare_cpu_ms\": %.3f, \"compare_wall_ms\": %.3f, \"differences\": %zu", comparing.CpuMilliseconds(),
                    comparing.WallMilliseconds(), comparison.Differences());
    }
    std::printf("}\n");
    std::fflush(stdout);
    _exit(0);  // as bench_steps
}

}  // namespace
}  // namespace NORVZEL20

int main(int argc, char** argv)
{
    std::vector<std::string> files;
    std::string output = "/dev/null";
    CLI::App options("Compares inventories as tables of text");
    options.add_option("FILE", files, "inventories, the reference first")->required();
    options.add_option("--output", output, "file for the differences");
    CLI11_PARSE(options, argc, argv);
    try {
        NORVZEL20::Run(files, output);
    } catch (const std::exception& error) {
        std::cerr << "peer_flat: " << error.what() << '\n';
    }
    return 2;
}
