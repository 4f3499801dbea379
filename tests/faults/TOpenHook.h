#pragma once

#include <cstdio>
#include <functional>
#include <string>

namespace NORVZEL20 {

/// While it lives, std::fopen of one path does something else, in a program that has this file among its sources.
///
/// Threads: one; one hook at a time.
class TOpenHook {
  public:
    using TOpen = std::function<std::FILE*(const char* mode)>;

    TOpenHook(const std::string& path, TOpen open);
    TOpenHook(const TOpenHook&) = delete;
    TOpenHook& operator=(const TOpenHook&) = delete;
    ~TOpenHook();

    /// How often the path was opened.
    int GetCount() const { return fCount; }

    /// What std::fopen does without a hook.
    static std::FILE* OpenReally(const char* path, const char* mode);
    /// What std::fopen does.
    static std::FILE* Open(const char* path, const char* mode);

  private:
    std::string fPath;
    TOpen fOpen;
    int fCount = 0;
};

}  // namespace NORVZEL20
