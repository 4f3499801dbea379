// Files that change while they are read: the program's own calls of read() and readdir() go through this file, which changes them.
#include <dirent.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <cerrno>

#include "tests/client/collect/TCollectFixture.h"

namespace {

// Is called with each descriptor before it is read; returns the error that reading is to give, or 0.
std::function<int(int)> fgBeforeRead;

bool IsRefused(int descriptor)
{
    const int error = fgBeforeRead ? fgBeforeRead(descriptor) : 0;
    errno = error == 0 ? errno : error;
    return error != 0;
}

}  // namespace

extern "C" ssize_t __real_read(int descriptor, void* buffer, size_t size);

extern "C" ssize_t __wrap_read(int descriptor, void* buffer, size_t size)
{
    return IsRefused(descriptor) ? -1 : __real_read(descriptor, buffer, size);
}

extern "C" dirent* __real_readdir(DIR* folder);

extern "C" dirent* __wrap_readdir(DIR* folder)
{
    return IsRefused(dirfd(folder)) ? nullptr : __real_readdir(folder);
}

namespace NORVZEL20 {

class ChangingFilesTest : public TCollectFixture {
  protected:
    void TearDown() override { fgBeforeRead = nullptr; }

    /// Does something before each read of a file that is named so, with how often there were such reads before.
    void BeforeReading(const std::string& path, const std::function<int(int)>& action)
    {
        const std::string place = fSystem->Place(path);
        fgBeforeRead = [this, place, action](int descriptor) {
            char name[4096];
            const ssize_t length = readlink(("/proc/self/fd/" + std::to_string(descriptor)).c_str(), name, sizeof name);
            return length > 0 && std::string(name, static_cast<std::size_t>(length)) == place ? action(fReads++) : 0;
        };
    }

    std::string FilesLine()
    {
        fSystem->CollectTo("x.xml");
        const std::string lines = fSystem->GetLines();
        const std::size_t at = lines.find("not collected: files: ");
        return at == std::string::npos ? "nothing" : lines.substr(at + 22, lines.find('\n', at) - at - 22);
    }

    int fReads = 0;
};

TEST_F(ChangingFilesTest, FileThatGrowsOnceIsReadAgain)
{
    BeforeReading("/etc/ssh/sshd_config", [this](int reads) {
        if (reads == 0) {
            fSystem->Append("/etc/ssh/sshd_config", "Port 23\n");
        }
        return 0;
    });
    EXPECT_EQ("/etc/shadow: it may hold keys or passwords", FilesLine());
    EXPECT_LT(2, fReads);
}

TEST_F(ChangingFilesTest, FileThatGrowsAllTheTimeIsLeftOut)
{
    BeforeReading("/etc/ssh/sshd_config", [this](int reads) {
        if (reads % 2 == 0) {
            fSystem->Append("/etc/ssh/sshd_config", "Port 23\n");
        }
        return 0;
    });
    EXPECT_EQ("/etc/ssh/sshd_config: it changed while it was read; /etc/shadow: it may hold keys or passwords", FilesLine());
}

TEST_F(ChangingFilesTest, FileThatVanishesIsLeftOut)
{
    fSystem->File("/etc/ssh/a", "");
    BeforeReading("/etc/ssh/a", [this](int reads) {
        if (reads == 0) {
            fSystem->Unlink("/etc/ssh/sshd_config");
        }
        return 0;
    });
    EXPECT_EQ("/etc/shadow: it may hold keys or passwords; /etc/ssh/sshd_config: it vanished", FilesLine());
}

TEST_F(ChangingFilesTest, FileThatCannotBeReadIsLeftOut)
{
    BeforeReading("/etc/ssh/sshd_config", [](int) { return EIO; });
    EXPECT_EQ("/etc/ssh/sshd_config: Input/output error; /etc/shadow: it may hold keys or passwords", FilesLine());
}

TEST_F(ChangingFilesTest, FolderThatCannotBeReadToItsEndIsLeftOut)
{
    BeforeReading("/etc/ssh", [](int reads) { return reads < 3 ? 0 : EIO; });
    EXPECT_EQ("/etc/ssh: Input/output error; /etc/shadow: it may hold keys or passwords", FilesLine());
    EXPECT_EQ(std::string::npos, Show("KALMO_ConfigurationFile").find("sshd_config"));
}

TEST_F(ChangingFilesTest, InterruptedReadsGoOn)
{
    BeforeReading("/etc/ssh/sshd_config", [](int reads) { return reads < 3 ? EINTR : 0; });
    EXPECT_EQ("/etc/shadow: it may hold keys or passwords", FilesLine());
}

TEST_F(ChangingFilesTest, TableThatCannotBeReadIsLeftOut)
{
    BeforeReading("/var/lib/dpkg/status", [](int) { return EIO; });
    fSystem->CollectTo("x.xml");
    EXPECT_NE(std::string::npos, fSystem->GetLines().find("not collected: packages: /var/lib/dpkg/status: Input/output error\n"))
        << fSystem->GetLines();
}

}  // namespace NORVZEL20
