#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <utility>
#include <vector>

#include "host/TUnaryFunction.h"

namespace NORVZEL20 {

/// Appends every element of an enumeration to the caller's vector, repeated ones included.
///
/// The vector is not owned and must outlive the enumeration. Errors: those of the vector's allocation.
template <class T>
class TAddToVectorCallback : public TUnaryFunction<boost::shared_ptr<T>> {
  public:
    explicit TAddToVectorCallback(std::vector<boost::shared_ptr<T>>* elements) : fElements(elements) {}

    /// Always returns true, so the enumeration continues.
    bool operator()(boost::shared_ptr<T> element) const
    {
        fElements->push_back(std::move(element));
        return true;
    }

  private:
    std::vector<boost::shared_ptr<T>>* fElements;
};

}  // namespace NORVZEL20
