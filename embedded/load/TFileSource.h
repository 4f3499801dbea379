#pragma once

#include <cstddef>
#include <cstdio>
#include <memory>
#include <string>

namespace NORVZEL20 {

/// Reads a file piece by piece: a source of a document, which messages call by its path.
class TFileSource {
  public:
    /// Opens the file. Errors: TPopulateError with kFileError (11) if that fails.
    explicit TFileSource(const std::string& path);

    /// Reads at most `size` bytes and returns how many; 0 at the end. Errors: TPopulateError with kFileError (11).
    std::size_t operator()(char* buffer, std::size_t size);

  private:
    struct TCloser {
        void operator()(std::FILE* file) const noexcept { std::fclose(file); }
    };

    [[noreturn]] void Fail(const char* what) const;

    std::string fPath;
    std::unique_ptr<std::FILE, TCloser> fFile;
};

}  // namespace NORVZEL20
