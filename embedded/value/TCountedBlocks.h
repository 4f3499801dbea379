#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <vector>

#include "embedded/value/TCounted.h"
#include "embedded/value/TEmbeddedObject.h"

namespace NORVZEL20 {

/// The shared contents of an array value.
struct TCountedArray : TCounted {
    explicit TCountedArray(std::vector<TCIMValue> elements) : fElements(std::move(elements)) {}

    const std::vector<TCIMValue> fElements;
};

/// The shared contents of a string value that is an embedded object.
struct TCountedObject : TCounted {
    explicit TCountedObject(boost::shared_ptr<const TEmbeddedObject> object) : fObject(std::move(object)) {}

    const boost::shared_ptr<const TEmbeddedObject> fObject;
};

}  // namespace NORVZEL20
