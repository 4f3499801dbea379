#pragma once

#include <string>

namespace NORVZEL20 {

/// A name in a folder.
struct TFolderEntry {
    enum class EKind : unsigned char { kFile, kFolder, kLink, kOther };

    std::string name;
    EKind kind = EKind::kOther;
};

}  // namespace NORVZEL20
