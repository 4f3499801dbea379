#pragma once

#include <functional>
#include <string_view>

namespace NORVZEL20 {

/// Takes a text piece by piece.
using TTextSink = std::function<void(std::string_view)>;

}  // namespace NORVZEL20
