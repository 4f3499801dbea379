#pragma once

#include <functional>

namespace NORVZEL20 {

#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wdeprecated-declarations"
/// The base of the enumeration callbacks: gives them the nested types that older adapters ask for.
///
/// The standard base is deprecated since C++11; deriving from it here, once, keeps the warning enabled everywhere else.
template <class TArgument>
struct TUnaryFunction : std::unary_function<TArgument, bool> {};
#pragma GCC diagnostic pop

}  // namespace NORVZEL20
