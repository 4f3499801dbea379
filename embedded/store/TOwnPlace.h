#pragma once

#include <string>

#include "embedded/value/TNameText.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

/// The namespace and host that references within a namespace may name or leave out: one that names them is the same as one that
/// does not. This is the one place that decides it.
struct TOwnPlace {
    std::string namespaceName;
    std::string host;
    bool isAnyHostOwn = false;  ///< whether a reference that names another host is own too, because none is known to be foreign

    /// Whether a path with that namespace (not empty) and host (may be empty) is to this place. Letter case does not count.
    bool Contains(const std::string& name, const std::string& pathHost) const
    {
        return TNameText::Equal(name, namespaceName) && (pathHost.empty() || isAnyHostOwn || TNameText::Equal(pathHost, host));
    }
    /// The same for a path that may be without a namespace: that one is local already, so it is not in question.
    bool IsNamedBy(const TCIMReference& path) const
    {
        return !path.GetNamespaceName().empty() && Contains(path.GetNamespaceName(), path.GetHost());
    }
};

}  // namespace NORVZEL20
