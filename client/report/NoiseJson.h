#pragma once

#include <string>

#include "client/noise/TNoise.h"

namespace NORVZEL20 {

/// What was found, as one JSON document.
std::string WriteNoiseJson(const TNoise& noise);

}  // namespace NORVZEL20
