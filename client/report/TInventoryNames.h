#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace NORVZEL20 {

/// Names for sets of the inventories of a report.
class TInventoryNames {
  public:
    /// `labels` are those of the report, the reference first. They must outlive this. With `hasMajority`, the reference is none of
    /// the inventories. See NamesOf.
    TInventoryNames(const std::vector<std::string>& labels, bool hasMajority) : fLabels(labels), fHasMajority(hasMajority) {}

    /// The inventories as a short list, each shown as by DisplayLabel: `web02, web05`; three or more in a row that differ only in a
    /// number as `web21..23`; all but one or two of at least four others as `all but web07`, if these and the reference are fewer
    /// than they are; all of at least three others as `all`. `inventories` are ascending and not empty.
    std::string List(const std::vector<std::size_t>& inventories) const;

    /// Who lacks an instance that the reference has: `missing in web07`, or `only in web01, web07` if all others or all but one or
    /// two of at least four lack it, likewise.
    std::string WhoLacks(const std::vector<std::size_t>& inventories) const;
    /// Who has an instance that the reference lacks: `only in web07`, or likewise `missing in web01, web07 alone`.
    std::string WhoHas(const std::vector<std::size_t>& inventories) const;

  private:
    bool AreNearlyAll(const std::vector<std::size_t>& inventories) const;
    std::vector<std::size_t> Others(const std::vector<std::size_t>& inventories, std::size_t first) const;
    std::string Ranges(const std::vector<std::size_t>& inventories) const;

    const std::vector<std::string>& fLabels;
    const bool fHasMajority;
};

}  // namespace NORVZEL20
