#pragma once

#include <sys/stat.h>

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "client/collect/TFileText.h"
#include "client/collect/TFolderEntry.h"
#include "client/process/TDescriptor.h"

namespace NORVZEL20 {

/// The files of a system: "/" for the running one, another folder for a copy. Paths begin with a slash, and no link leads out of
/// the folder.
///
/// Nothing is ever written, and nothing but ordinary files and folders is opened: opening a pipe or a device could wait or change
/// something. Threads: one at a time.
class TSystemRoot {
  public:
    /// More is never read of one file, unless an operation says otherwise.
    static constexpr std::size_t kMostBytes = 64U << 20U;
    static constexpr std::size_t kMostEntries = 100'000;  ///< of one folder

    /// Errors: TClientError if there is no such folder.
    explicit TSystemRoot(const std::string& path);

    /// The whole of an ordinary file. Links are followed. A file of more than `mostBytes` is trouble.
    TFileText Read(const std::string& path, std::size_t mostBytes = kMostBytes) const;

    /// Opens an ordinary file; the last part of the path must not be a link. On failure `trouble` says why.
    TDescriptor OpenFile(const std::string& path, std::string& trouble) const;

    /// The names in a folder in ascending order, without "." and "..". On failure it is empty, and `trouble` says why, except that
    /// a folder that is missing has no names.
    std::vector<TFolderEntry> List(const std::string& path, std::string& trouble) const;
    /// The same if it does not matter why the folder cannot be read.
    std::vector<TFolderEntry> List(const std::string& path) const;

    /// Where a link leads; nothing if it is no link or cannot be read.
    std::optional<std::string> ReadLink(const std::string& path) const;

    /// What is known of a file without opening it. A link at the end of the path is not followed.
    std::optional<struct stat> Look(const std::string& path) const;

    /// Opens the folder or file for calls such as fstatvfs, without reading it.
    TDescriptor OpenPlace(const std::string& path) const;

    /// The system's reason for a failed call as people say it.
    static std::string TroubleOf(int error);

  private:
    TDescriptor Open(const std::string& path, int flags) const;

    TDescriptor fRoot;
    bool fIsRunning;
};

}  // namespace NORVZEL20
