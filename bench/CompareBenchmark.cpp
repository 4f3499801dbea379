// How long a comparison of loaded inventories takes: 100,000 instances of 13 properties in each of two or three namespaces.
//
// Loading is not measured. The figures of bench/yardstick have the same beside databases.

#include <benchmark/benchmark.h>

#include <boost/smart_ptr/shared_ptr.hpp>

#include "bench/BenchmarkFiles.h"
#include "bench/OperatingSystem.h"
#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/store/TInMemNamespace.h"
#include "host/TNamespaceProviderManager.h"
#include "provider/TDeltaNamespace.h"

namespace NORVZEL20 {
namespace {

boost::shared_ptr<TInMemNamespace> Load(const std::string& xml)
{
    boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
    TCimXmlPopulator(ns).LoadFromMemory(xml.data(), xml.size(), "bench.xml");
    AddOperatingSystem(ns);
    return ns;
}

boost::shared_ptr<TDeltaNamespace> AllocateDeltaNamespace()
{
    const auto provider = TNamespaceProviderManager::GetInstance()->FindProvider("delta");
    return boost::dynamic_pointer_cast<TDeltaNamespace>(provider->AllocateNamespace(TCallContext(), false, "delta"));
}

std::size_t CountRecords(TDeltaNamespace& ns)
{
    std::size_t count = 0;
    std::string language = "WQL";
    std::string query = "SELECT * FROM KALMO_Delta";
    ns.ExecuteQuery([&count](const boost::shared_ptr<ICIMInstance>&) { return ++count != 0; }, language, query, TCallContext());
    return count;
}

void SetRate(benchmark::State& state, std::size_t differences)
{
    state.counters["differences"] = static_cast<double>(differences);
    state.counters["per_instance"] = benchmark::Counter(static_cast<double>(state.iterations()) * kBenchInstances,
                                                        benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}

// With two namespaces the run also overwrites the values of the first; with three it only compares.
void BM_FindDifferences(benchmark::State& state)
{
    std::size_t differences = 0;
    for (auto _ : state) {
        state.PauseTiming();
        boost::shared_ptr<TDeltaNamespace> ns = AllocateDeltaNamespace();
        ns->SetSpecFileName(RulesFile());
        ns->AddNamespaceToCompareList(Load(FirstState()));
        for (std::int64_t other = 1; other < state.range(0); ++other) {
            ns->AddNamespaceToCompareList(Load(SecondState()));
        }
        state.ResumeTiming();
        ns->FindDifferences();
        state.PauseTiming();
        differences = CountRecords(*ns);
        ns.reset();
        state.ResumeTiming();
    }
    SetRate(state, differences);
}
BENCHMARK(BM_FindDifferences)->Arg(2)->Arg(3)->Unit(benchmark::kMillisecond)->Iterations(3);

}  // namespace
}  // namespace NORVZEL20
