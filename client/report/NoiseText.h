#pragma once

#include <string>

#include "client/noise/TNoise.h"
#include "client/report/TTextOptions.h"

namespace NORVZEL20 {

/// The rule as the option of `compare` that means the same: `--exclude Disk.Serial`.
std::string NoiseOption(const TNoiseRule& rule);

/// What speaks for the rule, in one line without an end.
std::string NoiseEvidence(const TNoise& noise, const TNoiseRule& rule);

/// What was found, for people: each rule with its evidence, what no rule explains, and what was compared.
std::string WriteNoiseText(const TNoise& noise, const TTextOptions& options);

}  // namespace NORVZEL20
