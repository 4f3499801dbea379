#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

namespace NORVZEL20 {

/// The same pointer without a use of its own, for an argument that is taken by value: copies of it cost no counting.
///
/// The caller must keep the object alive for as long as the result or a copy of it is used.
template <class T>
boost::shared_ptr<T> Borrow(const boost::shared_ptr<T>& pointer) noexcept
{
    return boost::shared_ptr<T>(boost::shared_ptr<void>(), pointer.get());
}

}  // namespace NORVZEL20
