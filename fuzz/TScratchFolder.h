#pragma once

#include <map>
#include <string>

namespace NORVZEL20 {

/// A folder with the given files, which is the process's working folder while this lives. Temporary files go there too.
///
/// All objects use the same folder and empty it first, so only one may live at a time. The first one also makes standard input
/// empty for the rest of the process.
class TScratchFolder {
  public:
    using TFiles = std::map<std::string, std::string>;  ///< contents by name

    explicit TScratchFolder(const TFiles& files);
    TScratchFolder(const TScratchFolder&) = delete;
    TScratchFolder& operator=(const TScratchFolder&) = delete;
    ~TScratchFolder();

    /// The files that are in the folder now.
    TFiles Read() const;

  private:
    int fBefore;
};

}  // namespace NORVZEL20
