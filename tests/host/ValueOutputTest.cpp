#include <gtest/gtest.h>

#include <ostream>
#include <sstream>
#include <type_traits>
#include <utility>

#include "host/TCIMReference.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {
namespace {

template <class TStream, class TPrinted, class = void>
struct TCanPrint : std::false_type {};

template <class TStream, class TPrinted>
struct TCanPrint<TStream, TPrinted, std::void_t<decltype(std::declval<TStream>() << std::declval<TPrinted>())>> : std::true_type {};

template <class TPrinted>
std::string StreamsThatPrint()
{
    return std::string(TCanPrint<std::ostream&, TPrinted>::value ? "narrow " : "") +
           (TCanPrint<std::wostream&, TPrinted>::value ? "wide " : "") +
           (TCanPrint<std::ostringstream&, TPrinted>::value ? "derived " : "") +
           (TCanPrint<std::ostringstream, TPrinted>::value ? "temporary " : "");
}

// A value converts to a number, and a stream prints numbers. The conversion throws for most values.
TEST(ValueOutputTest, AValueCannotBeWrittenToAStream)
{
    EXPECT_EQ("narrow wide derived temporary ", StreamsThatPrint<unsigned short>());
    EXPECT_EQ("", StreamsThatPrint<TCIMValue>());
    EXPECT_EQ("", StreamsThatPrint<TCIMValue&>());
    EXPECT_EQ("", StreamsThatPrint<const TCIMValue&>());
    EXPECT_EQ("", StreamsThatPrint<TCIMReference>());
}

TEST(ValueOutputTest, TheConversionsStay)
{
    EXPECT_TRUE((std::is_convertible_v<const TCIMValue&, unsigned short>));
    EXPECT_TRUE((std::is_convertible_v<const TCIMValue&, TCIMReference>));
    const unsigned short number = TCIMValue(7);
    EXPECT_EQ(7, number);
}

}  // namespace
}  // namespace NORVZEL20
