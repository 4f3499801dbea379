#include "host/TZELException.h"
#include "tests/spec/TSpecFixture.h"

namespace NORVZEL20 {
namespace {

class SpecCallsTest : public TSpecFixture, public testing::WithParamInterface<EHost> {
  protected:
    SpecCallsTest() : TSpecFixture(GetParam()) {}

    std::string CallsOf(const std::string& document)
    {
        fComparison.GetWatch().Forget();
        Read(document);
        return fComparison.GetWatch().TakeText();
    }
};

INSTANTIATE_TEST_SUITE_P(Hosts, SpecCallsTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

TEST_P(SpecCallsTest, AnEmptyDocumentAsksNothing)
{
    EXPECT_EQ("", CallsOf("<DifftoolSpec version=\"1.0\"/>"));
}

TEST_P(SpecCallsTest, NamesAreLookedUpAsTheyAreReadAndRulesHandedDownAtTheEnd)
{
    EXPECT_EQ("ns0.GetClass(\"Base\") {}\n"
              "ns0.GetClass(\"Base\") {}\n"
              "ns0:Base.GetPropertyDecl(\"A\") {}\n"
              "ns0.GetClass(\"Base\") {}\n"
              "ns0:Base.GetPropertyDecl(\"B\") {}\n"
              "ns0.GetClass(\"Base\") {}\n"
              "ns0:Base.EnumerateSubClasses(false) {}\n"
              "ns0:Sub.GetName() {}\n"
              "ns0.GetClass(\"Sub\") {}\n"
              "ns0:Sub.EnumerateSubClasses(false) {}\n"
              "ns0.GetClass(\"Other\") {}\n"
              "ns0.GetClass(\"Other\") {}\n"
              "ns0:Other.EnumerateSubClasses(false) {}\n",
              CallsOf("<DifftoolSpec><class name=\"Base\"><includelist><value>A</value></includelist>"
                      "<excludelist><value>B</value></excludelist></class><class name=\"Other\"/></DifftoolSpec>"));
}

TEST_P(SpecCallsTest, ABadAttributeIsReportedBeforeTheClassIsLookedUp)
{
    EXPECT_EQ("", CallsOf("<DifftoolSpec><class name=\"Other\" zoo=\"\"/></DifftoolSpec>"));
    EXPECT_EQ("", CallsOf("<DifftoolSpec><class/></DifftoolSpec>"));
}

TEST_P(SpecCallsTest, TheFirstNamespaceIsTheSchema)
{
    fNamespaces.insert(fNamespaces.begin(), fComparison.Watched(1));
    EXPECT_EQ("ns1.GetClass(\"Base\") {}\n", CallsOf("<DifftoolSpec><class name=\"Base\"/></DifftoolSpec>"));
}

}  // namespace
}  // namespace NORVZEL20
