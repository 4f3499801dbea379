#pragma once

#include <string>

namespace NORVZEL20 {

/// A file of its own name that is gone when this object is.
class TTemporaryFile {
  public:
    /// Makes a file with that content in the folder that TMPDIR names, else in /tmp. Errors: TClientError.
    explicit TTemporaryFile(const std::string& content);
    TTemporaryFile(const TTemporaryFile&) = delete;
    TTemporaryFile& operator=(const TTemporaryFile&) = delete;
    ~TTemporaryFile();

    const std::string& GetPath() const { return fPath; }

  private:
    std::string fPath;
};

}  // namespace NORVZEL20
