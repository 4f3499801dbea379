#include "fuzz/TScratchFolder.h"

#include <fcntl.h>
#include <stdlib.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <system_error>

namespace NORVZEL20 {

namespace {

void Require(bool succeeded, const char* what)
{
    if (!succeeded) {
        throw std::system_error(errno, std::generic_category(), what);
    }
}

/// The one folder of the process: made on first use and removed when the process ends.
class TFolder {
  public:
    TFolder()
    {
        char path[] = "/tmp/cimdelta-fuzz-XXXXXX";
        Require(mkdtemp(path) != nullptr, path);
        fPath = path;
        Require(setenv("TMPDIR", path, 1) == 0, "TMPDIR");
        const int nothing = open("/dev/null", O_RDONLY);
        Require(nothing >= 0 && dup2(nothing, STDIN_FILENO) >= 0, "standard input");
        close(nothing);
    }
    TFolder(const TFolder&) = delete;
    TFolder& operator=(const TFolder&) = delete;
    ~TFolder()
    {
        std::error_code ignored;
        std::filesystem::remove_all(fPath, ignored);
    }

    void Empty() const
    {
        for (const auto& entry : std::filesystem::directory_iterator(fPath)) {
            std::filesystem::remove_all(entry.path());
        }
    }

    const std::string& GetPath() const { return fPath; }

  private:
    std::string fPath;
};

const TFolder& GetFolder()
{
    static const TFolder fgFolder;
    return fgFolder;
}

}  // namespace

TScratchFolder::TScratchFolder(const TFiles& files) : fBefore(open(".", O_RDONLY | O_DIRECTORY | O_CLOEXEC))
{
    GetFolder().Empty();
    for (const auto& [name, content] : files) {
        std::ofstream(GetFolder().GetPath() + "/" + name, std::ios::binary) << content;
    }
    Require(fBefore >= 0 && chdir(GetFolder().GetPath().c_str()) == 0, "working folder");
}

TScratchFolder::~TScratchFolder()
{
    if (fchdir(fBefore) != 0) {
        std::abort();  // the next input would run in the wrong folder
    }
    close(fBefore);
}

TScratchFolder::TFiles TScratchFolder::Read() const
{
    TFiles files;
    for (const auto& entry : std::filesystem::directory_iterator(GetFolder().GetPath())) {
        std::ifstream stream(entry.path(), std::ios::binary);
        files[entry.path().filename().string()] = std::string(std::istreambuf_iterator<char>(stream), {});
    }
    return files;
}

}  // namespace NORVZEL20
