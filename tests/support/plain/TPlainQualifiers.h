#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "host/ICIMQualifier.h"

namespace NORVZEL20 {

/// The qualifiers of a class or a property of the plain host, in the order in which they were added.
class TPlainQualifiers {
  public:
    void Add(boost::shared_ptr<ICIMQualifier> qualifier) { fQualifiers.push_back(qualifier); }
    /// Null if there is none of that name, byte for byte.
    boost::shared_ptr<ICIMQualifier> Find(const std::string& name, TCallContext context) const;
    /// Errors: kNotFound (15).
    boost::shared_ptr<ICIMQualifier> Get(const std::string& name, TCallContext context) const;
    void Enumerate(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback) const;

  private:
    std::vector<boost::shared_ptr<ICIMQualifier>> fQualifiers;
};

}  // namespace NORVZEL20
