#pragma once

#include <string>

#include "embedded/mof/TMofFolders.h"

namespace NORVZEL20 {

/// Lets the MOF of an inventory include the files of its folders, but never the file that the result is going to replace.
class TIncludedFiles : public IMofIncludes {
  public:
    /// `output` is the path of the result; empty if it goes to standard output.
    explicit TIncludedFiles(std::string output);

    /// As TMofFolders::Add.
    void Add(const std::string& folder) { fFolders.Add(folder); }

    bool Find(const std::string& name, const std::string& from, TFile& file, std::string& reason) override;

    /// Errors: also TClientError if it is the file of the result, by whatever link.
    bool Read(const TFile& file, std::size_t most, std::string& bytes, std::string& reason) override;

  private:
    const std::string fOutput;
    TMofFolders fFolders;
};

}  // namespace NORVZEL20
