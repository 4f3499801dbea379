#pragma once

#include <boost/smart_ptr/make_shared.hpp>
#include <string>

#include "tests/support/watched/TWatchedInstance.h"

namespace NORVZEL20 {

/// An instance that lacks all its properties.
class TBareInstance : public TWatchedInstance {
  public:
    explicit TBareInstance(boost::shared_ptr<ICIMInstance> instance)
        : TWatchedInstance(instance, boost::make_shared<TCallWatch>(), "bare", "bare")
    {}

    boost::shared_ptr<ICIMProperty> GetProperty(const std::string&, TCallContext) const override { return nullptr; }
};

}  // namespace NORVZEL20
