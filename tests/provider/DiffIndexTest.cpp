#include <iomanip>
#include <iostream>
#include <locale>

#include "tests/provider/TDeltaFixture.h"
#include "tests/support/TOddLocale.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {
namespace {

class DiffIndexTest : public TDeltaFixture {
  protected:
    // The result or status of the call, and its text on standard output and in the log.
    std::string Ask(const TCallContext& context)
    {
        std::string answer;
        testing::internal::CaptureStdout();
        const int status = StatusOf([&] { answer = std::to_string(Delta().GetDiffIndex(context)); });
        const std::string output = testing::internal::GetCapturedStdout();
        return (status == 0 ? answer : "status " + std::to_string(status)) + "|" + output + fLog.Take();
    }

    std::string Ask(const TCIMValue& value)
    {
        TCallContext context;
        context["nsIndex"] = value;
        return Ask(context);
    }
};

TEST_F(DiffIndexTest, PositionsOfComparedNamespacesAreReturned)
{
    EXPECT_EQ("0|", Ask(At(0)));
    EXPECT_EQ("1|", Ask(At(1)));
    EXPECT_EQ("2|", Ask(At(2)));
}

TEST_F(DiffIndexTest, APositionBehindTheLastIsPrintedAndRefused)
{
    EXPECT_EQ("status 15|Bad nsIndex, nsIndex=3\n", Ask(At(3)));
    EXPECT_EQ("status 15|Bad nsIndex, nsIndex=65535\n", Ask(At(65535)));
}

// Changes how standard output writes numbers, and restores it at the end.
class TOddOutput {
  public:
    TOddOutput() : fFormat(nullptr), fLocale(std::cout.imbue(TOddLocale::Make()))
    {
        fFormat.copyfmt(std::cout);
        std::cout << std::hex << std::showbase << std::showpos << std::uppercase << std::left << std::setfill('*') << std::setw(40);
    }
    TOddOutput(const TOddOutput&) = delete;
    TOddOutput& operator=(const TOddOutput&) = delete;
    ~TOddOutput()
    {
        std::cout.copyfmt(fFormat);
        std::cout.imbue(fLocale);
    }

  private:
    std::ios fFormat;
    std::locale fLocale;
};

TEST_F(DiffIndexTest, TheNumberIsDecimalHoweverStandardOutputIsSet)
{
    const TOddOutput odd;
    EXPECT_EQ("status 15|Bad nsIndex, nsIndex=65535\n", Ask(At(65535)));
}

TEST_F(DiffIndexTest, WithoutAnIndexNothingIsPrinted)
{
    EXPECT_EQ("status 38|", Ask(TCallContext()));
    TCallContext other;
    other["NSINDEX"] = TCIMValue(static_cast<unsigned short>(1));
    other["nsIndex "] = TCIMValue(static_cast<unsigned short>(1));
    EXPECT_EQ("status 38|", Ask(other));
}

TEST_F(DiffIndexTest, OtherIntegersAreConvertedByTheHost)
{
    EXPECT_EQ("2|", Ask(TCIMValue(2)));
    EXPECT_EQ("1|", Ask(TCIMValue(static_cast<unsigned char>(1))));
    EXPECT_EQ("2|", Ask(TCIMValue(2ULL)));
}

TEST_F(DiffIndexTest, WhatDoesNotConvertFailsAsTheHostSays)
{
    EXPECT_EQ("status 13|", Ask(TCIMValue(-1)));
    EXPECT_EQ("status 13|", Ask(TCIMValue(65536)));
    EXPECT_EQ("status 13|", Ask(TCIMValue("1")));
    EXPECT_EQ("status 13|", Ask(TCIMValue()));
}

TEST_F(DiffIndexTest, WithNothingToCompareEveryIndexIsRefused)
{
    const auto delta = MakeDeltaNamespace(EHost::kPlain);
    testing::internal::CaptureStdout();
    EXPECT_EQ(15, StatusOf([&] { delta->GetDiffIndex(At(0)); }));
    EXPECT_EQ(38, StatusOf([&] { delta->GetDiffIndex(TCallContext()); }));
    EXPECT_EQ("Bad nsIndex, nsIndex=0\n", testing::internal::GetCapturedStdout());
}

TEST_F(DiffIndexTest, TheIndexIsHeldAgainstTheNumberCutToSixteenBits)
{
    while (TTestAccess::CompareList(Delta()).size() < 65536) {
        Delta().AddNamespaceToCompareList(nullptr);
    }
    EXPECT_EQ("status 15|Bad nsIndex, nsIndex=0\n", Ask(At(0)));
    EXPECT_EQ("status 15|Bad nsIndex, nsIndex=65535\n", Ask(At(65535)));
    Delta().AddNamespaceToCompareList(nullptr);
    EXPECT_EQ("0|", Ask(At(0)));
    EXPECT_EQ("status 15|Bad nsIndex, nsIndex=1\n", Ask(At(1)));
}

TEST_F(DiffIndexTest, NoNamespaceIsAsked)
{
    EXPECT_EQ("1|", Ask(At(1)));
    EXPECT_EQ("status 15|Bad nsIndex, nsIndex=3\n", Ask(At(3)));
    EXPECT_EQ("status 38|", Ask(TCallContext()));
    EXPECT_EQ("", Watch().TakeText());
}

}  // namespace
}  // namespace NORVZEL20
