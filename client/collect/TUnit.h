#pragma once

#include <string>
#include <vector>

#include "client/collect/read/TUnitFile.h"

namespace NORVZEL20 {

/// A systemd unit, as far as its files say.
struct TUnit {
    /// The state of a unit that a program has made for the time of its run.
    static constexpr char kTransient[] = "transient";

    TUnitFile file;
    std::string path;       ///< of the file; empty if there is only a link to a template
    std::string state;      ///< whether it is started with the system, in the words of UnitFileState; empty if it cannot be known
    bool isRead = true;     ///< the file could be read
    bool isLinked = false;  ///< the file is outside of the folders of units
    bool isWanted = false;  ///< a link in a folder such as multi-user.target.wants leads to it, whoever made it
    std::vector<std::string> dropIns;

    /// The unit that this one starts if it is a timer, a path or a socket of that name.
    std::string Activated(const std::string& name) const
    {
        return file.activated.empty() ? name.substr(0, name.rfind('.')) + ".service" : file.activated;
    }
};

}  // namespace NORVZEL20
