#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "client/findings/TChangeFinding.h"

namespace NORVZEL20 {

/// A property that changed in the same inventories. What is rare is thus not hidden among what is frequent: if 43 values changed in
/// three inventories and one more in another, these are two findings.
struct TPropertyFinding {
    std::string property;                  ///< of a part of an embedded instance, the path to it: `Settings.Speed`
    std::size_t instances = 0;             ///< how many instances it changed in
    std::size_t changes = 0;               ///< how many distinct changes there are
    std::vector<std::size_t> inventories;  ///< those in which it changed, ascending
    std::vector<TChangeFinding> examples;  ///< the changes that most instances have, most first; all of them if there are few
};

}  // namespace NORVZEL20
