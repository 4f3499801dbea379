#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

// An inventory names what could not be collected in instances of a class of its own, KALMO_NotCollected.

/// What was not collected for one reason. A plain value.
struct TNotCollected {
    std::string kind;  ///< of the things: "instances"
    std::string reason;
    std::vector<std::string> subjects;  ///< which ones; the first ones if there are many
    std::size_t count = 0;              ///< how many
};

/// What the inventory says that it lacks, in the order of its instances. Instances without a kind or a reason are left
/// out. Errors: std::bad_alloc.
std::vector<TNotCollected> FindNotCollected(TInMemNamespace& ns);

/// A document of CIM-XML that names what was not collected, with the declaration of the class if `declares`. It stands in that
/// namespace. Without anything, the document names the namespace and nothing else.
std::string WriteNotCollected(const std::string& namespaceName, const std::vector<TNotCollected>& all, bool declares);

/// The name of the class.
extern const char* const kNotCollectedClass;

}  // namespace NORVZEL20
