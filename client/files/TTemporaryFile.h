#pragma once

#include <string>

#include "client/files/TUnfinishedFile.h"

namespace NORVZEL20 {

/// A file with a name of its own that is removed when this object is destroyed, or when a signal ends the process.
class TTemporaryFile {
  public:
    /// Makes a file with that content in the folder that the environment variable TMPDIR names, or in /tmp if it names none.
    /// Errors: TClientError.
    explicit TTemporaryFile(const std::string& content);
    TTemporaryFile(const TTemporaryFile&) = delete;
    TTemporaryFile& operator=(const TTemporaryFile&) = delete;
    ~TTemporaryFile() = default;

    const std::string& GetPath() const { return fFile.GetPath(); }

  private:
    TUnfinishedFile fFile;
};

}  // namespace NORVZEL20
