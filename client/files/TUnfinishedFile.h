#pragma once

#include <string>

namespace NORVZEL20 {

/// A new file that is gone when this object is, or when a signal ends the process, unless it has got its place by then.
///
/// Threads: distinct files at once; made by the thread that gets the signals (see TSignalsHeld).
class TUnfinishedFile {
  public:
    /// Makes an empty file, readable by its owner alone, whose path begins with `begin`. Errors: GetError.
    explicit TUnfinishedFile(const std::string& begin);
    TUnfinishedFile(const TUnfinishedFile&) = delete;
    TUnfinishedFile& operator=(const TUnfinishedFile&) = delete;
    ~TUnfinishedFile();

    /// 0, or errno of what went wrong in making it: then there is no file.
    int GetError() const { return fError; }
    const std::string& GetPath() const { return fPath; }
    int GetDescriptor() const { return fDescriptor; }

    /// Closes the descriptor. Returns 0 or errno.
    int Close() noexcept;
    /// Gives the file its final name, whatever is there by that name. Returns 0 or errno.
    int MoveTo(const std::string& path) noexcept;

    /// Removes every such file there is. Made for signal handlers: calls nothing that they must not.
    static void RemoveAll() noexcept;

  private:
    void Forget() noexcept;

    std::string fPath;
    int fDescriptor = -1;
    int fError = 0;
    bool fIsThere = false;
    int fSlot = -1;
};

}  // namespace NORVZEL20
