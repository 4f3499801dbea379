#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "client/rules/TRules.h"
#include "host/ICIMInstance.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// The instances of one class of one namespace by their keys, usually as the rules define them. It holds no keys, only their
/// hashes: 24 bytes for each instance. Threads: one at a time.
class TInstanceIndex {
  public:
    using TInstances = std::vector<boost::shared_ptr<ICIMInstance>>;
    using TCallback = std::function<void(const std::string& key, const TInstances& instances)>;
    using TKeyOf = std::function<std::string(const boost::shared_ptr<ICIMInstance>&)>;

    /// Empty if the namespace does not declare the class. `rules` must outlive this, and no key of an instance may change
    /// meanwhile. Errors: TZELException of the namespace. Cost: one key for each instance.
    TInstanceIndex(ICIMNamespace& ns, const std::string& className, TRules& rules);

    /// The same of any class, which may be null, by any keys.
    TInstanceIndex(const boost::shared_ptr<ICIMClass>& cls, TKeyOf keyOf);

    /// The instances with that key, in the order in which they were added to the namespace; several only if keys are excluded.
    /// Empty for an unknown key. Valid until the next call. Cost: one key for each of them, none if the key is that of the last
    /// call.
    const TInstances& Find(const std::string& key);

    /// Calls back once for each key, in no particular order. Cost: one key for each instance.
    void ForEachKey(const TCallback& callback) const;

  private:
    using TEntry = std::pair<std::size_t, boost::shared_ptr<ICIMInstance>>;
    using TEntries = std::vector<TEntry>;

    const TKeyOf fKeyOf;
    TEntries fEntries;     // ascending by hash; with the same hash in the order of the namespace
    std::string fFoundBy;  // the key of the last call of Find, and what it has found
    TInstances fFound;
};

}  // namespace NORVZEL20
