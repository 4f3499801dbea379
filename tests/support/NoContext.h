#pragma once

#include "host/TCallContext.h"

namespace NORVZEL20 {

/// The empty context, with which most tests call.
inline const TCallContext kNoContext;

}  // namespace NORVZEL20
