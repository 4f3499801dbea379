#pragma once

#include <vector>

#include "client/report/html/TPageClass.h"
#include "client/report/html/TPageColumns.h"
#include "client/report/html/TPageFinding.h"
#include "client/report/html/TPageSets.h"
#include "client/report/html/TPageTexts.h"

namespace NORVZEL20 {

/// What a page holds of the differences.
struct TPageData {
    TPageTexts texts;
    TPageColumns columns;
    TPageSets sets;
    std::vector<TPageFinding> findings;  ///< by class; presences first, then properties ascending
    std::vector<TPageClass> classes;     ///< those with differences, in ascending order of their names
};

}  // namespace NORVZEL20
