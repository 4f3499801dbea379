#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <unordered_map>
#include <vector>

#include "client/rules/TRules.h"
#include "host/ICIMInstance.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// The instances of one class of one namespace under the keys that the rules give them.
class TInstanceIndex {
  public:
    using TInstances = std::vector<boost::shared_ptr<ICIMInstance>>;

    /// Cost: one key for each instance.
    TInstanceIndex(ICIMNamespace& ns, const std::string& className, TRules& rules);

    /// The instances with that key in order of insertion; none for a key that is not there. Valid while the index lives.
    const TInstances& Find(const std::string& key) const;

    /// How many instances share their key with an earlier one.
    std::size_t CountSharing() const { return fCount - fInstances.size(); }

  private:
    std::unordered_map<std::string, TInstances> fInstances;
    std::size_t fCount = 0;
};

}  // namespace NORVZEL20
