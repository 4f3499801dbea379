#pragma once

namespace NORVZEL20 {

/// Whether a text report is coloured.
enum class EColorChoice {
    kAuto,    ///< as the console says; never in a file
    kAlways,  ///< wherever it goes
    kNever
};

}  // namespace NORVZEL20
