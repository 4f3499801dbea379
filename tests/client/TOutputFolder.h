#pragma once

#include <gtest/gtest.h>
#include <stdlib.h>

#include <filesystem>
#include <set>
#include <string>

namespace NORVZEL20 {

/// A temporary folder, removed with everything in it when this object is destroyed.
class TOutputFolder {
  public:
    TOutputFolder() : fPath(::testing::TempDir() + "cimdelta-output-XXXXXX") { EXPECT_NE(nullptr, mkdtemp(&fPath[0])); }
    TOutputFolder(const TOutputFolder&) = delete;
    TOutputFolder& operator=(const TOutputFolder&) = delete;
    ~TOutputFolder() { std::filesystem::remove_all(fPath); }

    const std::string& GetPath() const { return fPath; }
    std::string operator/(const std::string& name) const { return fPath + "/" + name; }

    /// The names of the files in it in ascending order, each followed by a blank.
    std::string List() const
    {
        std::set<std::string> names;
        for (const auto& entry : std::filesystem::directory_iterator(fPath)) {
            names.insert(entry.path().filename().string());
        }
        std::string list;
        for (const std::string& name : names) {
            list += name + " ";
        }
        return list;
    }

  private:
    std::string fPath;
};

}  // namespace NORVZEL20
