#pragma once

#include <string>

#include "client/files/TUnfinishedFile.h"

namespace NORVZEL20 {

/// A file of its own name that is gone when this object is, or when a signal ends the process.
class TTemporaryFile {
  public:
    /// Makes a file with that content in the folder that TMPDIR names, else in /tmp. Errors: TClientError.
    explicit TTemporaryFile(const std::string& content);
    TTemporaryFile(const TTemporaryFile&) = delete;
    TTemporaryFile& operator=(const TTemporaryFile&) = delete;
    ~TTemporaryFile() = default;

    const std::string& GetPath() const { return fFile.GetPath(); }

  private:
    TUnfinishedFile fFile;
};

}  // namespace NORVZEL20
