#include <sqlite3.h>

#include <stdexcept>

#include "bench/peers/IPeerDatabase.h"

namespace NORVZEL20 {
namespace {

class TSqlite : public IPeerDatabase {
  public:
    TSqlite() { Check(sqlite3_open(":memory:", &fDatabase) == SQLITE_OK); }
    TSqlite(const TSqlite&) = delete;
    TSqlite& operator=(const TSqlite&) = delete;
    ~TSqlite() override { sqlite3_close(fDatabase); }

    void Fill(const std::string& table, std::size_t columns, std::size_t keys, const std::vector<TFlatRow>& rows) override
    {
        std::string names = "c0";
        std::string marks = "?";
        std::string identity = "c0";
        for (std::size_t column = 1; column < columns; ++column) {
            names += ",c" + std::to_string(column);
            marks += ",?";
            identity += column < keys ? ",c" + std::to_string(column) : "";
        }
        Execute("CREATE TABLE " + table + "(" + names + ", PRIMARY KEY(" + identity + ")) WITHOUT ROWID; BEGIN");
        const TStatement insert = Prepare("INSERT INTO " + table + " VALUES(" + marks + ")");
        for (const TFlatRow& row : rows) {
            for (std::size_t column = 0; column < columns; ++column) {
                const std::string& text = row.values[column];
                Check(sqlite3_bind_text(insert.get(), static_cast<int>(column) + 1, text.data(), static_cast<int>(text.size()),
                                        SQLITE_STATIC) == SQLITE_OK);
            }
            Check(sqlite3_step(insert.get()) == SQLITE_DONE);
            sqlite3_reset(insert.get());
        }
        Execute("COMMIT");
    }

    void Query(const std::string& sql, const TVisitRow& visit) override
    {
        const TStatement select = Prepare(sql);
        std::vector<std::string_view> cells(static_cast<std::size_t>(sqlite3_column_count(select.get())));
        int state = SQLITE_OK;
        while ((state = sqlite3_step(select.get())) == SQLITE_ROW) {
            for (std::size_t column = 0; column < cells.size(); ++column) {
                const void* text = sqlite3_column_text(select.get(), static_cast<int>(column));
                const int length = sqlite3_column_bytes(select.get(), static_cast<int>(column));
                cells[column] = std::string_view(static_cast<const char*>(text), static_cast<std::size_t>(length));
            }
            visit(cells);
        }
        Check(state == SQLITE_DONE);
    }

  private:
    using TStatement = std::unique_ptr<sqlite3_stmt, int (*)(sqlite3_stmt*)>;

    TStatement Prepare(const std::string& sql)
    {
        sqlite3_stmt* statement = nullptr;
        Check(sqlite3_prepare_v2(fDatabase, sql.c_str(), -1, &statement, nullptr) == SQLITE_OK);
        return {statement, sqlite3_finalize};
    }

    void Execute(const std::string& sql) { Check(sqlite3_exec(fDatabase, sql.c_str(), nullptr, nullptr, nullptr) == SQLITE_OK); }

    void Check(bool succeeded) const
    {
        if (!succeeded) {
            throw std::runtime_error(std::string("SQLite: ") + sqlite3_errmsg(fDatabase));
        }
    }

    sqlite3* fDatabase = nullptr;
};

}  // namespace

std::unique_ptr<IPeerDatabase> MakeSqlite()
{
    return std::make_unique<TSqlite>();
}

}  // namespace NORVZEL20
