// Answers the question of a comparison with a database in memory: which rows of the reference another inventory lacks, which it has
// besides, and which values of the others differ.
//
// Every inventory is a table of texts, and three queries are asked for each inventory but the reference. What differs in a row is
// found by looking at its cells, so every result is read. Filling the tables takes no part in the time. Prints one line of JSON;
// ends with status 3 if this program was built without the database.

#include <unistd.h>

#include <CLI/CLI.hpp>
#include <cstdio>
#include <exception>
#include <iostream>
#include <stdexcept>
#include <string>
#include <vector>

#include "bench/TStopwatch.h"
#include "bench/peers/IPeerDatabase.h"

namespace NORVZEL20 {
namespace {

constexpr int kNotBuilt = 3;

std::string Columns(const std::string& table, std::size_t columns)
{
    std::string list;
    for (std::size_t column = 0; column < columns; ++column) {
        list += (column == 0 ? "" : ",") + table + ".c" + std::to_string(column);
    }
    return list;
}

// `t0.c0<comparison>other.c0`, one for each column from `first` up to `last`, joined by the word.
std::string Conditions(const std::string& other, const char* comparison, const char* word, std::size_t first, std::size_t last)
{
    std::string list;
    for (std::size_t column = first; column < last; ++column) {
        const std::string name = ".c" + std::to_string(column);
        list.append(column == first ? "" : word).append("t0").append(name).append(comparison).append(other).append(name);
    }
    return list;
}

class TDatabaseComparison {
  public:
    explicit TDatabaseComparison(IPeerDatabase& database) : fDatabase(database) {}

    // The generated classes have the same properties, so one table holds the instances of all.
    void Fill(const TFlatInventory& inventory)
    {
        const TFlatClass& first = inventory.Classes().front();
        for (const TFlatClass& type : inventory.Classes()) {
            if (type.properties != first.properties || type.keys != first.keys || type.keys.back() + 1 != type.keys.size()) {
                throw std::runtime_error("the classes have other properties than one another, or keys that do not come first");
            }
        }
        fColumns = first.properties.size();
        fKeys = first.keys.size();
        fDatabase.Fill("t" + std::to_string(fTables++), fColumns, fKeys, inventory.Rows());
    }

    std::size_t CountDifferences()
    {
        std::size_t differences = 0;
        for (std::size_t table = 1; table < fTables; ++table) {
            const std::string other = "t" + std::to_string(table);
            differences += CountUnmatched("t0", other, other) + CountUnmatched(other, "t0", other) + CountChanged(other);
        }
        return differences;
    }

  private:
    std::size_t CountUnmatched(const std::string& table, const std::string& in, const std::string& other)
    {
        std::size_t rows = 0;
        fDatabase.Query("SELECT " + Columns(table, fColumns) + " FROM " + table + " WHERE NOT EXISTS (SELECT 1 FROM " + in +
                            " WHERE " + Conditions(other, "=", " AND ", 0, fKeys) + ")",
                        [&rows](const std::vector<std::string_view>&) { ++rows; });
        return rows;
    }

    std::size_t CountChanged(const std::string& other)
    {
        std::size_t values = 0;
        fDatabase.Query("SELECT " + Columns("t0", fColumns) + "," + Columns(other, fColumns) + " FROM t0 JOIN " + other + " ON " +
                            Conditions(other, "=", " AND ", 0, fKeys) + " WHERE " +
                            Conditions(other, "<>", " OR ", fKeys, fColumns),
                        [&](const std::vector<std::string_view>& cells) {
                            for (std::size_t column = fKeys; column < fColumns; ++column) {
                                values += cells[column] != cells[fColumns + column] ? 1 : 0;
                            }
                        });
        return values;
    }

    IPeerDatabase& fDatabase;
    std::size_t fTables = 0;
    std::size_t fColumns = 0;
    std::size_t fKeys = 0;
};

int Run(const std::string& name, const std::vector<std::string>& files)
{
    const std::unique_ptr<IPeerDatabase> database = name == "sqlite" ? MakeSqlite() : MakeDuckDb();
    if (!database) {
        return kNotBuilt;
    }
    TDatabaseComparison comparison(*database);
    for (const std::string& file : files) {
        comparison.Fill(TFlatInventory(file));
    }
    const TStopwatch watch;
    const std::size_t differences = comparison.CountDifferences();
    std::printf("{\"compare_cpu_ms\": %.3f, \"compare_wall_ms\": %.3f, \"differences\": %zu}\n", watch.CpuMilliseconds(),
                watch.WallMilliseconds(), differences);
    std::fflush(stdout);
    _exit(0);  // as bench_steps
}

}  // namespace
}  // namespace NORVZEL20

int main(int argc, char** argv)
{
    std::string database;
    std::vector<std::string> files;
    CLI::App options("Compares inventories as tables of a database in memory");
    options.add_option("DATABASE", database, "sqlite or duckdb")->required()->check(CLI::IsMember({"sqlite", "duckdb"}));
    options.add_option("FILE", files, "inventories, the reference first");
    CLI11_PARSE(options, argc, argv);
    try {
        return NORVZEL20::Run(database, files);
    } catch (const std::exception& error) {
        std::cerr << "peer_database: " << error.what() << '\n';
    }
    return 2;
}
