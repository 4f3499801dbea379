#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <vector>

#include "embedded/value/TCounted.h"
#include "embedded/value/TEmbeddedObject.h"

namespace NORVZEL20 {

/// The block of an array value.
struct TCountedArray : TCounted {
    explicit TCountedArray(std::vector<TCIMValue> contents) : elements(std::move(contents)) {}

    const std::vector<TCIMValue> elements;
};

/// The block of a string value that is an embedded object.
struct TCountedObject : TCounted {
    explicit TCountedObject(boost::shared_ptr<const TEmbeddedObject> contents) : object(std::move(contents)) {}

    const boost::shared_ptr<const TEmbeddedObject> object;
};

}  // namespace NORVZEL20
