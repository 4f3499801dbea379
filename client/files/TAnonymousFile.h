#pragma once

#include <memory>
#include <string>

#include "client/process/TDescriptor.h"

namespace NORVZEL20 {

/// A file in memory, in no folder, that other code of this process can open by a path. The kernel frees it when the process ends,
/// however it ends, so nothing can be left behind.
///
/// A program that is started meanwhile does not inherit it.
class TAnonymousFile {
  public:
    /// Makes a file with that content. Returns null if the kernel does not make such files, if there is no memory for the content,
    /// or if the path leads nowhere, as without /proc.
    static std::unique_ptr<TAnonymousFile> TryMake(const std::string& content);
    TAnonymousFile(const TAnonymousFile&) = delete;
    TAnonymousFile& operator=(const TAnonymousFile&) = delete;

    /// Valid in this process while this object lives. Each open of it begins at the start of the content.
    const std::string& GetPath() const { return fPath; }

  private:
    TAnonymousFile() = default;

    TDescriptor fDescriptor;
    std::string fPath;
};

}  // namespace NORVZEL20
