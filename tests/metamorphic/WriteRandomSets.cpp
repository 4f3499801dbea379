#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <stdexcept>
#include <string>

#include "embedded/cimxml/TCimXmlWriter.h"
#include "tests/engine/RandomSet.h"
#include "tests/engine/SetBuilding.h"

// Writes the sets of the agreement test as files, so that a program of its own can check what cimdelta says about them.
//
// Arguments: FOLDER FIRST COUNT. The set with the seed N goes to FOLDER/N: 0.xml, 1.xml, ... and rules.xml.

namespace NORVZEL20 {
namespace {

void WriteInventory(const TNaiveNamespace& plain, TNamespaceBuilder& builder, const std::filesystem::path& path)
{
    BuildNamespace(plain, builder);
    std::ofstream file(path);
    TCimXmlWriter([&file](std::string_view piece) { file << piece; }).WriteNamespace(*builder.GetNamespace());
    if (!file.flush()) {
        throw std::runtime_error("cannot write " + path.string());
    }
}

void WriteSet(std::uint64_t seed, const std::filesystem::path& folder)
{
    const TNaiveSet set = MakeRandomSet(seed, true);
    std::filesystem::create_directories(folder);
    TComparisonRun run(EHost::kInmem);
    run.SetWithOperatingSystem(false);
    for (std::size_t index = 0; index < set.namespaces.size(); ++index) {
        WriteInventory(set.namespaces[index], run.Namespace(index), folder / (std::to_string(index) + ".xml"));
    }
    std::ofstream(folder / "rules.xml") << RulesOf(set);
}

}  // namespace
}  // namespace NORVZEL20

int main(int argc, char** argv)
{
    if (argc != 4) {
        std::cerr << "usage: write_random_sets FOLDER FIRST COUNT\n";
        return 2;
    }
    const std::uint64_t first = std::strtoull(argv[2], nullptr, 10);
    const std::uint64_t count = std::strtoull(argv[3], nullptr, 10);
    for (std::uint64_t seed = first; seed < first + count; ++seed) {
        NORVZEL20::WriteSet(seed, std::filesystem::path(argv[1]) / std::to_string(seed));
    }
    return 0;
}
