#pragma once

#include <string>

namespace NORVZEL20 {

/// A file with the given contents, removed with this object.
class TTemporaryFile {
  public:
    explicit TTemporaryFile(const std::string& contents);
    TTemporaryFile(const TTemporaryFile&) = delete;
    TTemporaryFile& operator=(const TTemporaryFile&) = delete;
    ~TTemporaryFile();

    const std::string& GetPath() const { return fPath; }

  private:
    std::string fPath;
};

}  // namespace NORVZEL20
