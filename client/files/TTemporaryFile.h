#pragma once

#include <memory>
#include <string>

#include "client/files/TAnonymousFile.h"
#include "client/files/TUnfinishedFile.h"

namespace NORVZEL20 {

/// Text that other code of this process can read as a file, by a path. Nothing of it is left when this object is destroyed.
///
/// The file is an anonymous one (see TAnonymousFile), so nothing of it is left however the process ends. If there can be none, it
/// is a file in the folder that the environment variable TMPDIR names, or in /tmp, which a signal that ends the process removes
/// too.
class TTemporaryFile {
  public:
    /// Makes a file with that content. Errors: TClientError if not even a file in the folder can be made.
    explicit TTemporaryFile(const std::string& content);
    TTemporaryFile(const TTemporaryFile&) = delete;
    TTemporaryFile& operator=(const TTemporaryFile&) = delete;
    ~TTemporaryFile() = default;

    const std::string& GetPath() const { return fAnonymous ? fAnonymous->GetPath() : fNamed->GetPath(); }

  private:
    std::unique_ptr<TAnonymousFile> fAnonymous;  // null: there is fNamed
    std::unique_ptr<TUnfinishedFile> fNamed;
};

}  // namespace NORVZEL20
