#pragma once

#include <string>

namespace NORVZEL20 {

/// A file with the given contents, removed with this object.
class TScratchFile {
  public:
    explicit TScratchFile(const std::string& contents);
    TScratchFile(const TScratchFile&) = delete;
    TScratchFile& operator=(const TScratchFile&) = delete;
    ~TScratchFile();

    const std::string& GetPath() const { return fPath; }

  private:
    std::string fPath;
};

}  // namespace NORVZEL20
