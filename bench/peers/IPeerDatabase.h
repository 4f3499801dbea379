#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "bench/peers/TFlatInventory.h"

namespace NORVZEL20 {

/// A database in memory that can be filled with inventories and queried. Every operation throws std::runtime_error if it fails.
class IPeerDatabase {
  public:
    /// Gets one row of a result: the texts of its cells, which are valid during the call only.
    using TVisitRow = std::function<void(const std::vector<std::string_view>&)>;

    virtual ~IPeerDatabase() = default;

    /// Makes a table of texts with the columns c0, c1 and so on, of which the first `keys` identify a row, and fills it.
    virtual void Fill(const std::string& table, std::size_t columns, std::size_t keys, const std::vector<TFlatRow>& rows) = 0;

    virtual void Query(const std::string& sql, const TVisitRow& visit) = 0;
};

std::unique_ptr<IPeerDatabase> MakeSqlite();

/// Null if this program was built without DuckDB.
std::unique_ptr<IPeerDatabase> MakeDuckDb();

}  // namespace NORVZEL20
