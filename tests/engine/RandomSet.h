#pragma once

#include <cstdint>
#include <functional>

#include "tests/engine/NaiveSet.h"

namespace NORVZEL20 {

/// A small set of namespaces and rules. The same seed gives the same set.
///
/// One to five namespaces with a tree of up to five classes; some namespaces lack a class or a property. Keys and values are of
/// every type that a key can have. They are few, so keys of instances often agree, also when they are written in different ways.
/// With `isStrict`, no two instances of a namespace have the same keys, and no key is null.
TNaiveSet MakeRandomSet(std::uint64_t seed, bool isStrict);

/// The same with the draws of a source.
TNaiveSet MakeRandomSet(const std::function<std::uint64_t()>& source, bool isStrict);

}  // namespace NORVZEL20
