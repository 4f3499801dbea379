// The text of an exception is asked for in handlers that must not fail. A death test runs in a process of its own, so there the
// question is the first one.

#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>

#include "host/TZELException.h"
#include "tests/faults/TFailingAllocator.h"

namespace NORVZEL20 {
namespace {

[[noreturn]] void AskWithoutMemory(TZELStatusCode::EStatusCode status)
{
    TFailingAllocator::Fail(1, TFailingAllocator::EMode::kFromThenOn);
    const char* const text = TZELException(status).what();
    const bool hasFailed = TFailingAllocator::HasFailed();
    TFailingAllocator::Stop();
    std::fprintf(stderr, "%s%s\n", text, hasFailed ? ", but memory was asked for" : "");
    std::_Exit(0);
}

TEST(StatusTextDeathTest, TheFirstTextOfAProcessNeedsNoMemory)
{
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    EXPECT_EXIT(AskWithoutMemory(TZELStatusCode::kQueryLanguageUnknown), testing::ExitedWithCode(0), "^Unknown query language\n$");
    EXPECT_EXIT(AskWithoutMemory(static_cast<TZELStatusCode::EStatusCode>(2)), testing::ExitedWithCode(0), "^Unknown status\n$");
}

}  // namespace
}  // namespace NORVZEL20
