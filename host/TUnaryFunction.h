#pragma once

#include <functional>

namespace NORVZEL20 {

#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wdeprecated-declarations"
/// The base of the enumeration callbacks. It has the nested types that older adapters need.
///
/// The standard base is deprecated since C++11. It is used in this one place, and the warning stays enabled everywhere else.
template <class TArgument>
struct TUnaryFunction : std::unary_function<TArgument, bool> {};
#pragma GCC diagnostic pop

}  // namespace NORVZEL20
