#pragma once

#include <map>
#include <set>
#include <string>
#include <vector>

#include "client/collect/TCollection.h"
#include "client/collect/TUnit.h"

namespace NORVZEL20 {

/// The systemd units of a system that have a file: services, sockets, timers, paths, targets and automounts.
class TUnitFiles {
  public:
    /// Reads all files of units. A file or folder that cannot be read is left out of the collection. Errors:
    /// TCollection::TTimeIsUp.
    explicit TUnitFiles(TCollection& collection);

    /// By name.
    const std::map<std::string, TUnit>& GetUnits() const noexcept { return fUnits; }

    /// Whether it is the name of a unit of a kind that is collected.
    static bool IsUnitName(const std::string& name);

  private:
    void TakeFolder(const std::string& folder);
    /// A folder that cannot be read is left out of the collection.
    std::vector<TFolderEntry> EntriesOf(const std::string& folder);
    void TakeUnit(const std::string& folder, const TFolderEntry& entry);
    void TakeHidden(const std::string& path, TUnit& unit);
    void TakeLink(const std::string& folder, const std::string& name, TUnit& unit);
    void TakeOtherName(const std::string& folder, const std::string& name, const std::string& target);
    void TakeText(const std::string& path, TUnit& unit);
    void TakeEnabled(const std::string& folder, const std::string& subfolder);
    void TakeDropIns(const std::string& folder, const std::string& subfolder);
    void AddEnabledInstances();
    void FinishUnit(const std::string& name, TUnit& unit);
    std::string StateByLinks(const std::string& name, const TUnit& unit) const;

    TCollection& fCollection;
    std::map<std::string, TUnit> fUnits;
    std::map<std::string, std::string> fEnabled;  // the state by the names that are linked
    std::set<std::string> fWanted;                // names of such links in all folders, and of what they lead to
    // Links that lead to a unit by another name: name of the unit, name of the link, state.
    std::map<std::string, std::map<std::string, std::string>> fOtherNames;
    std::map<std::string, std::map<std::string, std::string>> fDropIns;  // unit, name of the file, path
};

}  // namespace NORVZEL20
