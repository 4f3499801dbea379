#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdio>

#include "embedded/services/TSpdLogger.h"
#include "tests/faults/FailEachAllocation.h"

namespace NORVZEL20 {
namespace {

/// Writes an entry that is too long for any buffer on the stack.
class TLogEntry : public IFaultyAction {
  public:
    void Act() override { fLogger.Log(0, fEntry); }
    void Verify(const std::string& outcome) override { EXPECT_EQ("", outcome); }

  private:
    TSpdLogger fLogger;
    std::string fEntry = std::string(2000, 'x') + "\n";
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

  private:
    std::FILE* fFile = std::tmpfile();
    int fBefore;
};

TEST(LoggerOutOfMemory, LosesTheEntryAndNeverThrows)
{
    const TStandardErrorAside aside;
    EXPECT_EQ("", FailEachAllocation("Log", std::make_unique<TLogEntry>));
}

}  // namespace
}  // namespace NORVZEL20
