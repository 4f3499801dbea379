#pragma once

#include <string>

#include "host/Export.h"

namespace NORVZEL20 {

/// The status of an error that a server answers with, by its number (DSP0200): "CIM_ERR_NOT_FOUND (6)". For an unknown number, or
/// something else than a number, `status "x"`.
CIMDELTA_INTERNAL_EXPORT std::string DescribeCimStatus(const std::string& code);

}  // namespace NORVZEL20
