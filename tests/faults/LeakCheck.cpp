#include "tests/faults/LeakCheck.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "embedded/value/TValueAccess.h"
#include "tests/faults/TFailingAllocator.h"

namespace NORVZEL20 {

void ExpectNothingLeft(const std::function<void()>& call)
{
    const std::ptrdiff_t files = CountOpenFiles();
    TValueAccess::FreeSparePaths();
    const TFailingAllocator::TUsage before = TFailingAllocator::GetLive();
    call();
    TValueAccess::FreeSparePaths();
    const TFailingAllocator::TUsage after = TFailingAllocator::GetLive();
    EXPECT_EQ(before.blocks, after.blocks);
    EXPECT_EQ(before.bytes, after.bytes);
    EXPECT_EQ(files, CountOpenFiles());
}

std::ptrdiff_t CountOpenFiles()
{
    return std::distance(std::filesystem::directory_iterator("/proc/self/fd"), std::filesystem::directory_iterator());
}

}  // namespace NORVZEL20
