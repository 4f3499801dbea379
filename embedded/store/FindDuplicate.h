#pragma once

#include <string>

#include "embedded/store/TInMemClass.h"

namespace NORVZEL20 {

/// The path that two instances of exactly this class have, or an empty text: for a caller that has written keys again. Cost: the
/// path of each instance.
std::string FindDuplicate(TInMemClass& cls);

}  // namespace NORVZEL20
