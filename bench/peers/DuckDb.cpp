#include <duckdb.h>

#include <stdexcept>

#include "bench/peers/IPeerDatabase.h"

namespace NORVZEL20 {
namespace {

// One result of a query, freed with the object.
struct TDuckDbResult {
    TDuckDbResult() = default;
    TDuckDbResult(const TDuckDbResult&) = delete;
    TDuckDbResult& operator=(const TDuckDbResult&) = delete;
    ~TDuckDbResult() { duckdb_destroy_result(&result); }

    duckdb_result result{};
};

class TDuckDb : public IPeerDatabase {
  public:
    TDuckDb()
    {
        Check(duckdb_open(nullptr, &fDatabase), "cannot be opened");
        Check(duckdb_connect(fDatabase, &fConnection), "cannot be connected to");
        // A run of the comparison takes one thread, too.
        Execute("SET threads = 1");
    }
    TDuckDb(const TDuckDb&) = delete;
    TDuckDb& operator=(const TDuckDb&) = delete;
    ~TDuckDb() override
    {
        duckdb_disconnect(&fConnection);
        duckdb_close(&fDatabase);
    }

    // It joins by a hash that it makes for each query, so an index would not be used.
    void Fill(const std::string& table, std::size_t columns, std::size_t /*keys*/, const std::vector<TFlatRow>& rows) override
    {
        std::string names;
        for (std::size_t column = 0; column < columns; ++column) {
            names += (column == 0 ? "c" : ", c") + std::to_string(column) + " VARCHAR NOT NULL";
        }
        Execute("CREATE TABLE " + table + "(" + names + ")");
        duckdb_appender appender = nullptr;
        Check(duckdb_appender_create(fConnection, nullptr, table.c_str(), &appender), "cannot append");
        bool done = true;
        for (const TFlatRow& row : rows) {
            for (const std::string& text : row.values) {
                done = duckdb_append_varchar_length(appender, text.data(), text.size()) == DuckDBSuccess && done;
            }
            done = duckdb_appender_end_row(appender) == DuckDBSuccess && done;
        }
        done = duckdb_appender_close(appender) == DuckDBSuccess && done;
        duckdb_appender_destroy(&appender);
        Check(done ? DuckDBSuccess : DuckDBError, "cannot append");
    }

    void Query(const std::string& sql, const TVisitRow& visit) override
    {
        TDuckDbResult query;
        Ask(sql, query);
        const idx_t columns = duckdb_column_count(&query.result);
        while (duckdb_data_chunk chunk = duckdb_fetch_chunk(query.result)) {
            VisitRows(chunk, columns, visit);
            duckdb_destroy_data_chunk(&chunk);
        }
    }

  private:
    void Ask(const std::string& sql, TDuckDbResult& answer)
    {
        if (duckdb_query(fConnection, sql.c_str(), &answer.result) != DuckDBSuccess) {
            throw std::runtime_error(std::string("DuckDB: ") + duckdb_result_error(&answer.result));
        }
    }

    void Execute(const std::string& sql)
    {
        TDuckDbResult unread;
        Ask(sql, unread);
    }

    static void VisitRows(duckdb_data_chunk chunk, idx_t columns, const TVisitRow& visit)
    {
        std::vector<duckdb_string_t*> texts;
        for (idx_t column = 0; column < columns; ++column) {
            texts.push_back(static_cast<duckdb_string_t*>(duckdb_vector_get_data(duckdb_data_chunk_get_vector(chunk, column))));
        }
        std::vector<std::string_view> cells(columns);
        for (idx_t row = 0; row < duckdb_data_chunk_get_size(chunk); ++row) {
            for (idx_t column = 0; column < columns; ++column) {
                duckdb_string_t& text = texts[column][row];
                cells[column] = std::string_view(duckdb_string_t_data(&text), duckdb_string_t_length(text));
            }
            visit(cells);
        }
    }

    static void Check(duckdb_state state, const char* fault)
    {
        if (state != DuckDBSuccess) {
            throw std::runtime_error(std::string("DuckDB: ") + fault);
        }
    }

    duckdb_database fDatabase = nullptr;
    duckdb_connection fConnection = nullptr;
};

}  // namespace

std::unique_ptr<IPeerDatabase> MakeDuckDb()
{
    return std::make_unique<TDuckDb>();
}

}  // namespace NORVZEL20
