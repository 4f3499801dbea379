#include "tests/faults/LeakCheck.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "embedded/value/TValueAccess.h"

namespace NORVZEL20 {

void ExpectNothingLeft(const std::function<void()>& call)
{
    const std::ptrdiff_t files = CountOpenFiles();
    const TFailingAllocator::TUsage before = GetLiveWithoutSpares();
    call();
    const TFailingAllocator::TUsage after = GetLiveWithoutSpares();
    EXPECT_EQ(before.blocks, after.blocks);
    EXPECT_EQ(before.bytes, after.bytes);
    EXPECT_EQ(files, CountOpenFiles());
}

TFailingAllocator::TUsage GetLiveWithoutSpares()
{
    TValueAccess::FreeSparePaths();
    return TFailingAllocator::GetLive();
}

std::ptrdiff_t CountOpenFiles()
{
    return std::distance(std::filesystem::directory_iterator("/proc/self/fd"), std::filesystem::directory_iterator());
}

}  // namespace NORVZEL20
