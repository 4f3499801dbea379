#pragma once

#include <cstdio>
#include <functional>
#include <string>

namespace NORVZEL20 {

/// Replaces std::fopen for one path while this object lives. The program must be linked with this file.
///
/// Threads: one. Only one hook may exist at a time.
class TOpenHook {
  public:
    using TOpen = std::function<std::FILE*(const char* mode)>;

    TOpenHook(const std::string& path, TOpen open);
    TOpenHook(const TOpenHook&) = delete;
    TOpenHook& operator=(const TOpenHook&) = delete;
    ~TOpenHook();

    /// How often the path was opened.
    int GetCount() const { return fCount; }

    /// std::fopen without the hook.
    static std::FILE* OpenReally(const char* path, const char* mode);
    /// std::fopen with the hook.
    static std::FILE* Open(const char* path, const char* mode);

  private:
    std::string fPath;
    TOpen fOpen;
    int fCount = 0;
};

}  // namespace NORVZEL20
