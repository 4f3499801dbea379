#include <gtest/gtest.h>
#include <unistd.h>

#include <algorithm>
#include <cstdio>
#include <fstream>
#include <string>
#include <vector>

#include "embedded/services/TSpdLogger.h"
#include "tests/faults/FailEachAllocation.h"

namespace NORVZEL20 {
namespace {

const std::string kEntry(2000, 'x');

/// Writes an entry that is too long for any buffer on the stack.
class TLogEntry : public IFaultyAction {
  public:
    void Act() override { fLogger.Log(0, fEntry); }
    void Verify(const std::string& outcome) override { EXPECT_EQ("", outcome); }

  private:
    TSpdLogger fLogger;
    std::string fEntry = kEntry + "\n";
};

/// Redirects standard error to a file while this object lives.
class TStandardErrorAside {
  public:
    TStandardErrorAside() : fBefore(dup(STDERR_FILENO)) { dup2(fileno(fFile), STDERR_FILENO); }
    TStandardErrorAside(const TStandardErrorAside&) = delete;
    TStandardErrorAside& operator=(const TStandardErrorAside&) = delete;
    ~TStandardErrorAside()
    {
        dup2(fBefore, STDERR_FILENO);
        close(fBefore);
        std::fclose(fFile);
    }

    /// The lines written so far that have something of an entry.
    std::vector<std::string> GetEntries() const
    {
        std::ifstream file("/proc/self/fd/" + std::to_string(fileno(fFile)));
        std::vector<std::string> entries;
        for (std::string line; std::getline(file, line);) {
            if (line.find("xx") != std::string::npos) {
                entries.push_back(line);
            }
        }
        return entries;
    }

  private:
    std::FILE* fFile = std::tmpfile();
    int fBefore;
};

TEST(LoggerOutOfMemory, NeverThrowsAndWritesAnEntryWholeOrNot)
{
    const TStandardErrorAside aside;
    EXPECT_EQ("", FailEachAllocation("Log", std::make_unique<TLogEntry>));
    const std::vector<std::string> entries = aside.GetEntries();
    EXPECT_GE(entries.size(), 3u) << "nothing fails in the first two and in the last attempt";
    for (const std::string& entry : entries) {
        EXPECT_EQ(kEntry, entry.substr(std::min(entry.find("xx"), entry.size())));
    }
}

}  // namespace
}  // namespace NORVZEL20
