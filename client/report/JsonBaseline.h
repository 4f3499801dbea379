#pragma once

#include <nlohmann/json.hpp>

#include "client/comparison/TBaselineOutcome.h"

namespace NORVZEL20 {

/// What a baseline says of a run, as an object. Its shape is drawn in JsonBaseline.cpp.
nlohmann::ordered_json JsonOfBaseline(const TBaselineOutcome& outcome);

}  // namespace NORVZEL20
