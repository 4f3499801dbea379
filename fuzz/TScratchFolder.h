#pragma once

#include <map>
#include <string>

namespace NORVZEL20 {

/// An empty folder that is the process's working folder, and the place of its temporary files, while this lives.
///
/// The folder is one for the whole process; standard input is empty from the first one on.
class TScratchFolder {
  public:
    using TFiles = std::map<std::string, std::string>;  ///< contents by name

    explicit TScratchFolder(const TFiles& files);
    TScratchFolder(const TScratchFolder&) = delete;
    TScratchFolder& operator=(const TScratchFolder&) = delete;
    ~TScratchFolder();

    /// What the folder holds now.
    TFiles Read() const;

  private:
    int fBefore;
};

}  // namespace NORVZEL20
