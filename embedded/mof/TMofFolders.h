#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "embedded/mof/IMofIncludes.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// Lets documents include the files of some folders, and no others.
///
/// A name is looked up beside the document that includes the file, then in each folder. A symbolic link is followed if it leads to
/// a place within one of the folders. Slashes and backslashes separate folders. Errors: std::bad_alloc only.
class CIMDELTA_EXPORT TMofFolders : public IMofIncludes {
  public:
    /// Adds a folder with all that is below it. A folder that is not there, or that was added before, adds nothing.
    void Add(const std::string& folder);
    std::size_t CountFolders() const noexcept { return fFolders.size(); }

    bool Find(const std::string& name, const std::string& from, TFile& file, std::string& reason) override;
    bool Read(const TFile& file, std::size_t most, std::string& bytes, std::string& reason) override;

  private:
    /// Whether the path, without links, is within one of the folders.
    bool Contains(const std::string& path) const;

    std::vector<std::string> fFolders;  // as given
    std::vector<std::string> fRoots;    // the same without links, each with a slash at its end
};

}  // namespace NORVZEL20
