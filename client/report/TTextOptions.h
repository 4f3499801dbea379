#pragma once

#include <cstddef>

namespace NORVZEL20 {

/// How a comparison is written as text.
struct TTextOptions {
    bool isColored = false;         ///< with escape sequences for a terminal
    bool isDetailed = false;        ///< every difference on its own, with the whole coverage
    bool isSummary = false;         ///< who differs and how much, without the findings
    bool hasWholeCoverage = false;  ///< the whole coverage, not only its summary
    bool showsOutliers = false;     ///< by inventories, rarest first, instead of by class; the reference is the majority
    bool hasWholeKeys = false;      ///< keys and values whole, however long
    bool hasWholeGroups = false;    ///< groups whole, if the lines are not too many: few properties were asked for
    std::size_t width = 120;        ///< columns at which contents are cut; 0 for no limit
    std::size_t mostLines = 0;      ///< how long the findings may be if groups are shortened; 0 for no limit
    bool isLimitChosen = false;     ///< whether a person chose that, so that it also holds for the properties that are asked for
    /// What shows all that is shortened, as the report names it.
    const char* detailOption = "--detail";
};

}  // namespace NORVZEL20
