#pragma once

#include <sys/types.h>

#include <optional>
#include <string>

namespace NORVZEL20 {

/// Which file it is, whatever path or link leads to it.
struct TFileIdentity {
    dev_t device;
    ino_t inode;
};

inline bool operator==(const TFileIdentity& a, const TFileIdentity& b) noexcept
{
    return a.device == b.device && a.inode == b.inode;
}

/// The file at the end of a path, or behind standard input for "-". Returns nothing if there is none.
std::optional<TFileIdentity> IdentifyFile(const std::string& path) noexcept;

}  // namespace NORVZEL20
