#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace NORVZEL20 {

/// Names for sets of the inventories of a report.
class TInventoryNames {
  public:
    /// `labels` are those of the report, the reference first. They must outlive this.
    explicit TInventoryNames(const std::vector<std::string>& labels) : fLabels(labels) {}

    /// The inventories as a short list, each shown as by DisplayLabel: `web02, web05`; three or more in a row that differ only in a
    /// number as `web21..23`; all but one or two of at least four others as `all but web07`; all of at least three others as `all`.
    /// `inventories` are ascending and not empty.
    std::string List(const std::vector<std::size_t>& inventories) const;

  private:
    std::string Ranges(const std::vector<std::size_t>& inventories) const;

    const std::vector<std::string>& fLabels;
};

}  // namespace NORVZEL20
