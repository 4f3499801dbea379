#pragma once

#include <string>
#include <system_error>

namespace NORVZEL20 {

/// A new file that is removed when this object is destroyed, or when a signal ends the process, unless MoveTo has given it its
/// final name by then.
///
/// Threads: different files may be used concurrently. Construct them in the thread that receives the signals (see TSignalsHeld).
class TUnfinishedFile {
  public:
    /// Makes an empty file, readable by its owner alone, whose path is `begin` and six characters more.
    /// Errors: std::system_error; there is no file then.
    explicit TUnfinishedFile(const std::string& begin);
    TUnfinishedFile(const TUnfinishedFile&) = delete;
    TUnfinishedFile& operator=(const TUnfinishedFile&) = delete;
    ~TUnfinishedFile();

    const std::string& GetPath() const { return fPath; }
    /// Open for writing until Close.
    int GetDescriptor() const { return fDescriptor; }

    /// Closes the descriptor, if it is still open. Errors: std::system_error; the descriptor is closed even then.
    void Close();

    /// Gives the file its final name in place of what has that name. Errors: std::system_error; the file is still unfinished.
    void MoveTo(const std::string& path);

    /// Removes the unfinished files of the process, eight at most. A signal handler may call it: it takes no lock and no memory.
    static void RemoveAll() noexcept;

  private:
    std::error_code CloseDescriptor() noexcept;
    void Forget() noexcept;

    std::string fPath;
    int fDescriptor = -1;
    bool fIsThere = false;
    int fSlot = -1;  // of the path in the list that RemoveAll reads; -1: none
};

}  // namespace NORVZEL20
