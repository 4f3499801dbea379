#pragma once

#include <cstdint>
#include <functional>

#include "tests/engine/NaiveSet.h"

namespace NORVZEL20 {

/// A small set of namespaces and rules, the same one for the same seed.
///
/// One to five namespaces, a tree of up to five classes of which some lack a class or a property, few values, so that instances
/// meet; with `isStrict` no two instances of a namespace have the same keys and no key is null.
TNaiveSet MakeRandomSet(std::uint64_t seed, bool isStrict);

/// The same with the draws of a source.
TNaiveSet MakeRandomSet(const std::function<std::uint64_t()>& source, bool isStrict);

}  // namespace NORVZEL20
