// How long a comparison takes, beside a database that answers the same question.
//
// Both sides hold the same 100,000 instances of 13 properties: the comparison in two or three namespaces, the database in two
// tables of texts with the keys as primary key. Both find rows of one side only and matched rows with a value that differs. Loading
// is not measured. The comparison does more than the queries: it writes a record for each difference.

#include <benchmark/benchmark.h>
#include <sqlite3.h>

#include <boost/smart_ptr/shared_ptr.hpp>

#include "bench/BenchmarkFiles.h"
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

class TDatabase {
  public:
    TDatabase() { sqlite3_open(":memory:", &fDatabase); }
    TDatabase(const TDatabase&) = delete;
    TDatabase& operator=(const TDatabase&) = delete;
    ~TDatabase() { sqlite3_close(fDatabase); }

    bool Execute(const std::string& sql) { return sqlite3_exec(fDatabase, sql.c_str(), nullptr, nullptr, nullptr) == SQLITE_OK; }

    // Inserts one row for each instance: the texts of its 13 values.
    bool Fill(const std::string& table, TInMemNamespace& ns)
    {
        Execute("CREATE TABLE " + table + "(k1,k2,a,b,c,d,e,f,g,h,i,j,k, PRIMARY KEY(k1,k2)) WITHOUT ROWID; BEGIN");
        sqlite3_stmt* insert = nullptr;
        sqlite3_prepare_v2(fDatabase, ("INSERT INTO " + table + " VALUES(?,?,?,?,?,?,?,?,?,?,?,?,?)").c_str(), -1, &insert,
                           nullptr);
        bool done = insert != nullptr;
        const auto row = [&](const boost::shared_ptr<ICIMInstance>& instance) { return done = Insert(insert, *instance) && done; };
        ns.GetClass("BENCH_Software", TCallContext())->EnumerateInstances(row, false, TCallContext());
        sqlite3_finalize(insert);
        return Execute("COMMIT") && done;
    }

    std::size_t CountRows(const std::string& sql)
    {
        sqlite3_stmt* select = nullptr;
        sqlite3_prepare_v2(fDatabase, sql.c_str(), -1, &select, nullptr);
        std::size_t rows = 0;
        while (sqlite3_step(select) == SQLITE_ROW) {
            ++rows;
        }
        sqlite3_finalize(select);
        return rows;
    }

  private:
    static bool Insert(sqlite3_stmt* insert, ICIMInstance& instance)
    {
        int column = 0;
        instance.EnumerateProperties(
            [&](const boost::shared_ptr<ICIMProperty>& property) {
                const std::string text = property->GetValue(TCallContext()).ToText();
                return sqlite3_bind_text(insert, ++column, text.c_str(), static_cast<int>(text.size()), SQLITE_TRANSIENT) ==
                       SQLITE_OK;
            },
            TCallContext());
        const bool inserted = sqlite3_step(insert) == SQLITE_DONE;
        sqlite3_reset(insert);
        return inserted;
    }

    sqlite3* fDatabase = nullptr;
};

// Three queries: the rows only in x, the rows only in y, and the matched rows with a value that differs.
void BM_DatabaseJoin(benchmark::State& state)
{
    TDatabase database;
    if (!database.Fill("x", *Load(FirstState())) || !database.Fill("y", *Load(SecondState()))) {
        state.SkipWithError("the tables could not be filled");
        return;
    }
    std::size_t rows = 0;
    for (auto _ : state) {
        rows = database.CountRows("SELECT k1,k2 FROM x WHERE NOT EXISTS (SELECT 1 FROM y WHERE y.k1=x.k1 AND y.k2=x.k2)");
        rows += database.CountRows("SELECT k1,k2 FROM y WHERE NOT EXISTS (SELECT 1 FROM x WHERE y.k1=x.k1 AND y.k2=x.k2)");
        rows += database.CountRows("SELECT x.*, y.* FROM x JOIN y ON y.k1=x.k1 AND y.k2=x.k2 WHERE x.a<>y.a OR x.b<>y.b OR "
                                   "x.c<>y.c OR x.d<>y.d OR x.e<>y.e "
                                   "OR x.f<>y.f OR x.g<>y.g OR x.h<>y.h OR x.i<>y.i OR x.j<>y.j OR x.k<>y.k");
    }
    SetRate(state, rows);
}
BENCHMARK(BM_DatabaseJoin)->Unit(benchmark::kMillisecond)->Iterations(3);

}  // namespace
}  // namespace NORVZEL20
