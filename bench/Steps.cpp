// Loads inventories, compares them under rules, and prints what each step took as one line of JSON.
//
// The steps are those of `cimdelta compare` without its report, one inventory after the other and in one thread, so CPU time and
// heap can be attributed to a step. Without rules nothing is compared, and the peak memory of the process is that of the
// inventories.

#include <unistd.h>

#include <CLI/CLI.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdio>
#include <exception>
#include <iostream>
#include <string>
#include <vector>

#include "bench/HeapBytes.h"
#include "bench/OperatingSystem.h"
#include "bench/TStopwatch.h"
#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/store/TInMemNamespace.h"
#include "host/TNamespaceProviderManager.h"
#include "provider/DeltaNames.h"
#include "provider/TDeltaNamespace.h"

namespace NORVZEL20 {
namespace {

using TInventories = std::vector<boost::shared_ptr<TInMemNamespace>>;

TInventories LoadAll(const std::vector<std::string>& files)
{
    TInventories inventories;
    const std::size_t before = HeapBytes();
    const TStopwatch watch;
    for (const std::string& file : files) {
        inventories.push_back(TInMemNamespace::Create("root/cimv2"));
        TCimXmlPopulator(inventories.back()).LoadFile(file);
    }
    std::printf("{\"load_cpu_ms\": %.3f, \"load_wall_ms\": %.3f, \"heap_bytes\": %zu", watch.CpuMilliseconds(),
                watch.WallMilliseconds(), HeapBytes() - before);
    return inventories;
}

// A difference counts once for each inventory that it holds for, as it does for a peer that compares pairs.
std::size_t CountDifferences(TDeltaNamespace& ns)
{
    std::size_t count = 0;
    std::string language = "WQL";
    std::string query = std::string("SELECT * FROM ") + kDeltaRecord;
    const auto add = [&count](const boost::shared_ptr<ICIMInstance>& record) {
        count += record->GetProperty(kDeltaRecordIndices, TCallContext())->GetValue(TCallContext()).GetElements().size();
        return true;
    };
    ns.ExecuteQuery(add, language, query, TCallContext());
    return count;
}

void Compare(const TInventories& inventories, const std::string& rules)
{
    const auto provider = TNamespaceProviderManager::GetInstance()->FindProvider(kDeltaProviderName);
    const auto delta =
        boost::dynamic_pointer_cast<TDeltaNamespace>(provider->AllocateNamespace(TCallContext(), false, kDeltaProviderName));
    delta->SetSpecFileName(rules);
    for (const boost::shared_ptr<TInMemNamespace>& inventory : inventories) {
        AddOperatingSystem(inventory);
        delta->AddNamespaceToCompareList(inventory);
    }
    const TStopwatch watch;
    delta->FindDifferences();
    std::printf(", \"compare_cpu_ms\": %.3f, \"compare_wall_ms\": %.3f", watch.CpuMilliseconds(), watch.WallMilliseconds());
    std::printf(", \"differences\": %zu", CountDifferences(*delta));
}

void Run(const std::vector<std::string>& files, const std::string& rules)
{
    const TInventories inventories = LoadAll(files);
    if (!rules.empty()) {
        Compare(inventories, rules);
    }
    std::printf("}\n");
    std::fflush(stdout);
    _exit(0);  // freeing every instance takes as long as a comparison, and nobody reads its time
}

}  // namespace
}  // namespace NORVZEL20

int main(int argc, char** argv)
{
    std::vector<std::string> files;
    std::string rules;
    CLI::App options("Times loading and comparing inventories");
    options.add_option("FILE", files, "inventories, the reference first")->required();
    options.add_option("--spec", rules, "rules; without them, the inventories are only loaded");
    CLI11_PARSE(options, argc, argv);
    try {
        NORVZEL20::Run(files, rules);
    } catch (const std::exception& error) {
        std::cerr << "bench_steps: " << error.what() << '\n';
    }
    return 2;
}
