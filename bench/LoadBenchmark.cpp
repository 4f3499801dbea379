// How long an inventory takes to load, beside bare XML parsers on the same bytes.
//
// Expat is the parser that the host uses. Here its handlers do nothing, so its time is the least that loading can take; the figure
// to watch is the ratio of the two. libxml2 is there for comparison. The memory of the loaded namespace is the growth of the heap.

#include <benchmark/benchmark.h>
#include <expat.h>
#include <libxml/parser.h>

#include <cstring>

#include "bench/BenchmarkFiles.h"
#include "bench/HeapBytes.h"
#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {
namespace {

void SetRates(benchmark::State& state, const std::string& xml)
{
    state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations() * xml.size()));
    state.counters["per_instance"] = benchmark::Counter(static_cast<double>(state.iterations()) * kBenchInstances,
                                                        benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}

void BM_ExpatEmptyHandlers(benchmark::State& state)
{
    const std::string& xml = FirstState();
    for (auto _ : state) {
        XML_Parser parser = XML_ParserCreate(nullptr);
        XML_SetElementHandler(
            parser, [](void*, const XML_Char*, const XML_Char**) {}, [](void*, const XML_Char*) {});
        XML_SetCharacterDataHandler(parser, [](void*, const XML_Char*, int) {});
        if (XML_Parse(parser, xml.data(), static_cast<int>(xml.size()), 1) != XML_STATUS_OK) {
            state.SkipWithError("the inventory is not well-formed");
        }
        XML_ParserFree(parser);
    }
    SetRates(state, xml);
}
BENCHMARK(BM_ExpatEmptyHandlers)->Unit(benchmark::kMillisecond);

void BM_Libxml2Sax2EmptyHandlers(benchmark::State& state)
{
    const std::string& xml = FirstState();
    xmlSAXHandler handler;
    std::memset(&handler, 0, sizeof handler);
    handler.initialized = XML_SAX2_MAGIC;
    handler.startElementNs = [](void*, const xmlChar*, const xmlChar*, const xmlChar*, int, const xmlChar**, int, int,
                                const xmlChar**) {};
    handler.endElementNs = [](void*, const xmlChar*, const xmlChar*, const xmlChar*) {};
    handler.characters = [](void*, const xmlChar*, int) {};
    for (auto _ : state) {
        if (xmlSAXUserParseMemory(&handler, nullptr, xml.data(), static_cast<int>(xml.size())) != 0) {
            state.SkipWithError("the inventory is not well-formed");
        }
    }
    SetRates(state, xml);
}
BENCHMARK(BM_Libxml2Sax2EmptyHandlers)->Unit(benchmark::kMillisecond);

void BM_LoadInventory(benchmark::State& state)
{
    const std::string& xml = FirstState();
    double bytes = 0;
    for (auto _ : state) {
        const std::size_t before = HeapBytes();
        boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
        TCimXmlPopulator(ns).LoadFromMemory(xml.data(), xml.size(), "bench.xml");
        state.PauseTiming();
        bytes = static_cast<double>(HeapBytes() - before);
        ns.reset();
        state.ResumeTiming();
    }
    SetRates(state, xml);
    state.counters["heap_per_instance"] = bytes / kBenchInstances;
}
BENCHMARK(BM_LoadInventory)->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace NORVZEL20
