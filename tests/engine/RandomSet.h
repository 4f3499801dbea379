#pragma once

#include <cstdint>
#include <functional>

#include "tests/engine/NaiveSet.h"

namespace NORVZEL20 {

/// A small set of namespaces and rules. The same seed gives the same set.
///
/// One to five namespaces with a tree of up to five classes; some namespaces lack a class or a property. Values are few, so keys of
/// instances often agree. With `isStrict`, no two instances of a namespace have the same keys, and no key is null.
TNaiveSet MakeRandomSet(std::uint64_t seed, bool isStrict);

/// The same with the draws of a source.
TNaiveSet MakeRandomSet(const std::function<std::uint64_t()>& source, bool isStrict);

}  // namespace NORVZEL20
