#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <utility>
#include <vector>

#include "client/comparison/TDifference.h"

namespace NORVZEL20 {

/// What a page shows as one finding: a property that changed, or instances that the same inventories lack or have alone.
struct TPageFinding {
    /// What is shown of it before the rows are unpacked. Texts are cut.
    struct TExample {
        std::vector<std::string> names;                             ///< of its first instances
        std::vector<std::pair<std::string, std::string>> contents;  ///< of the first, if instances came or went
        std::string reference;                                      ///< of the first change: the reference's value
        std::vector<std::pair<std::string, std::uint32_t>> others;  ///< and each other value, with the number of its set
        std::string shortText;                                      ///< the same change in short, if there is such a text
    };

    TDifference::EKind kind = TDifference::kChanged;
    std::size_t classNumber = 0;  ///< in TPageData::classes
    std::string property;         ///< of kChanged; of a part of an embedded instance, the path to it
    std::uint32_t set = 0;        ///< the number of the set of the inventories that differ
    std::size_t firstRow = 0;
    std::size_t rows = 0;     ///< as many as it has instances
    std::size_t changes = 0;  ///< distinct ones, of kChanged
    std::size_t rarity = 0;   ///< how many inventories have the value that the fewest have; "missing" is a value
    TExample example;
};

}  // namespace NORVZEL20
