#include <gtest/gtest.h>

#include <map>
#include <set>
#include <string>
#include <type_traits>

#include "host/TCIMValue.h"
#include "host/TCallContext.h"
#include "host/TZELException.h"

namespace NORVZEL20 {
namespace {

TEST(ExceptionTest, TextIsThatOfItsStatus)
{
    for (const auto status : {TZELStatusCode::kNotOffered, TZELStatusCode::kParseError, TZELStatusCode::kNotSupported}) {
        const TZELException error{TZELStatusCode(status)};
        EXPECT_EQ(TZELStatusCode(status).TranslateStatusCode(), error.what());
        EXPECT_EQ(status, error.GetStatusCode().GetStatus());
    }
}

TEST(ExceptionTest, StatusesOfThePlugInHaveDistinctTexts)
{
    std::set<std::string> texts;
    for (const auto number : {0, 1, 3, 4, 9, 11, 13, 15, 31, 37, 38}) {
        texts.insert(TZELStatusCode(static_cast<TZELStatusCode::EStatusCode>(number)).TranslateStatusCode());
    }
    EXPECT_EQ(11u, texts.size());
}

TEST(ExceptionTest, IsAStandardExceptionWithoutThrowingText)
{
    EXPECT_TRUE((std::is_base_of_v<std::exception, TZELException>));
    EXPECT_TRUE(noexcept(std::declval<const TZELException&>().what()));
}

TEST(CallContextTest, IsAPlainMapWithExactKeys)
{
    EXPECT_TRUE((std::is_same_v<std::map<std::string, TCIMValue>, TCallContext>));
}

}  // namespace
}  // namespace NORVZEL20
