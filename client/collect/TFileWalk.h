#pragma once

#include <sys/stat.h>

#include <functional>
#include <set>
#include <string>

#include "client/collect/TCollection.h"

namespace NORVZEL20 {

/// Goes through the files of a folder and of those below it, in ascending order of their names. Links are not followed, and file
/// systems of other systems are not entered.
class TFileWalk {
  public:
    static constexpr std::size_t kMostFiles = 200'000;  ///< of one walk
    static constexpr int kMostFolders = 64;             ///< within each other

    /// Takes the path and what is known of it. For a folder, returns whether to go into it.
    using TVisit = std::function<bool(const std::string& path, const struct stat& status)>;

    /// `isWanted` says of a path, before it is looked at, whether it is visited.
    TFileWalk(TCollection& collection, std::function<bool(const std::string& path)> isWanted, TVisit visit);

    /// A folder that is missing has no files. What cannot be read is left out of the collection. Errors: TCollection::TTimeIsUp.
    void Walk(const std::string& folder) { WalkFolder(folder, 0); }

  private:
    void WalkFolder(const std::string& folder, int depth);

    TCollection& fCollection;
    std::function<bool(const std::string&)> fIsWanted;
    TVisit fVisit;
    std::set<std::string> fRemote;  // where file systems of other systems are mounted
    std::size_t fCount = 0;
};

}  // namespace NORVZEL20
