#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <unordered_map>
#include <vector>

#include "client/rules/TRules.h"
#include "host/ICIMInstance.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// The instances of one class of one namespace by their keys, as the rules define them.
class TInstanceIndex {
  public:
    using TInstances = std::vector<boost::shared_ptr<ICIMInstance>>;

    using TByKey = std::unordered_map<std::string, TInstances>;

    /// Empty if the namespace does not declare the class. Errors: TZELException of the namespace. Cost: one key for each instance.
    TInstanceIndex(ICIMNamespace& ns, const std::string& className, TRules& rules);

    /// The instances with that key, in the order in which they were added to the namespace; several only if keys are excluded.
    /// Empty for an unknown key. Valid while the index lives.
    const TInstances& Find(const std::string& key) const;

    /// All instances, in no particular order of their keys. Valid while the index lives.
    const TByKey& GetAll() const { return fInstances; }

  private:
    TByKey fInstances;
};

}  // namespace NORVZEL20
