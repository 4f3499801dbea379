#pragma once

#include <cstddef>
#include <string>

namespace NORVZEL20 {

/// Finds and reads the files that MOF documents include. It decides which ones they may include.
class IMofIncludes {
  public:
    struct TFile {
        std::string name;      ///< what messages call the file; `from` of what it includes itself
        std::string identity;  ///< the same for the same file, however it was reached
    };

    virtual ~IMofIncludes() = default;

    /// Finds the file `name`, as the document `from` writes it. Returns false, and says why in `reason`, if there is none or if it
    /// may not be included.
    virtual bool Find(const std::string& name, const std::string& from, TFile& file, std::string& reason) = 0;

    /// Reads a file that Find has found. Returns false, and says why in `reason`, if it cannot be read or has more than `most`
    /// bytes.
    virtual bool Read(const TFile& file, std::size_t most, std::string& bytes, std::string& reason) = 0;
};

}  // namespace NORVZEL20
