#include "client/findings/InventoriesByCount.h"

namespace NORVZEL20 {

TInventoriesByCount InventoriesByCount(const TFindings& findings)
{
    TInventoriesByCount byCount;
    for (std::size_t i = 1; i < findings.differences.size(); ++i) {
        byCount[findings.differences[i]].push_back(i);
    }
    return byCount;
}

}  // namespace NORVZEL20
