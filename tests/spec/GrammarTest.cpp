#include "tests/spec/TSpecFixture.h"

namespace NORVZEL20 {
namespace {

class GrammarTest : public TSpecFixture, public testing::WithParamInterface<EHost> {
  protected:
    GrammarTest() : TSpecFixture(GetParam()) {}
};

INSTANTIATE_TEST_SUITE_P(Hosts, GrammarTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

TEST_P(GrammarTest, AnEmptyDocumentGivesNoRules)
{
    EXPECT_EQ("", Read("<DifftoolSpec/>"));
    EXPECT_EQ("", Read("<?xml version=\"1.0\"?>\n<DifftoolSpec version=\"1.0\"></DifftoolSpec>\n"));
    EXPECT_EQ("", TakeLog());
}

TEST_P(GrammarTest, VersionsUpToOnePointZeroAreAcceptedAsText)
{
    for (const std::string version : {"1.0", "1", "0.9", "0.5.3", "0.1", ""}) {
        EXPECT_EQ("", Read("<DifftoolSpec version=\"" + version + "\"/>")) << version;
    }
}

TEST_P(GrammarTest, VersionsThatCompareGreaterAreRefused)
{
    for (const std::string version : {"1.1", "1.0 ", "1.00", "1.01", "2", "10", "a"}) {
        EXPECT_EQ("status 9", Read("<DifftoolSpec version=\"" + version + "\"/>")) << version;
    }
}

TEST_P(GrammarTest, AFullDocumentIsRead)
{
    EXPECT_EQ("Base include B:EXCLUDE -Id -Name\n"
              "Other exclude A:INCLUDE\n"
              "Sub include B:EXCLUDE -Id -Name\n",
              Read("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
                   "<!-- a comment -->\n"
                   "<DifftoolSpec version=\"1.0\">\n"
                   "  <class name=\"Base\" default=\"include\" excludekeys=\"Id Name\">\n"
                   "    <excludelist>\n"
                   "      <value>B</value>\n"
                   "    </excludelist>\n"
                   "  </class>\n"
                   "  <class name=\"Other\" default=\"exclude\">\n"
                   "    <includelist><value>A</value></includelist>\n"
                   "  </class>\n"
                   "</DifftoolSpec>\n"));
}

TEST_P(GrammarTest, AClassWithoutListsHasDefaultAndExcludedKeysOnly)
{
    EXPECT_EQ("Other include -Id\n",
              Read("<DifftoolSpec><class excludekeys=\"Id\" default=\"include\" name=\"Other\"/></DifftoolSpec>"));
}

TEST_P(GrammarTest, WithoutADefaultEverythingIsExcluded)
{
    EXPECT_EQ("Other exclude\n", Read("<DifftoolSpec><class name=\"Other\"/></DifftoolSpec>"));
}

TEST_P(GrammarTest, ExcludedKeysAreSeparatedByAnyWhiteSpace)
{
    EXPECT_EQ("Other exclude -KeyA -KeyB -KeyC\n",
              Read("<DifftoolSpec><class name=\"Other\" excludekeys=\"  KeyA&#9;KeyB&#10; KeyC \"/></DifftoolSpec>"));
    EXPECT_EQ("Other exclude\n", Read("<DifftoolSpec><class name=\"Other\" excludekeys=\" \"/></DifftoolSpec>"));
}

TEST_P(GrammarTest, ListsComeInAnyOrderAndNumber)
{
    EXPECT_EQ("Base exclude A:EXCLUDE B:INCLUDE Id:INCLUDE Kind:EXCLUDE\n"
              "Sub exclude A:EXCLUDE B:INCLUDE Id:INCLUDE Kind:EXCLUDE\n",
              Read("<DifftoolSpec><class name=\"Base\">"
                   "<excludelist><value>A</value><value>Kind</value></excludelist><includelist/>"
                   "<includelist><value>B</value></includelist><excludelist/><includelist><value>Id</value></includelist>"
                   "</class></DifftoolSpec>"));
}

TEST_P(GrammarTest, TheFirstListingOfAPropertyStays)
{
    EXPECT_EQ("Other exclude A:INCLUDE\n", Read("<DifftoolSpec><class name=\"Other\"><includelist><value>A</value></includelist>"
                                                "<excludelist><value>A</value></excludelist></class></DifftoolSpec>"));
    EXPECT_EQ("Other exclude A:EXCLUDE\n", Read("<DifftoolSpec><class name=\"Other\"><excludelist><value>A</value></excludelist>"
                                                "<includelist><value>A</value></includelist></class></DifftoolSpec>"));
}

TEST_P(GrammarTest, InheritedPropertiesMayBeListed)
{
    EXPECT_EQ("Sub exclude A:INCLUDE C:INCLUDE\n",
              Read("<DifftoolSpec><class "
                   "name=\"Sub\"><includelist><value>A</value><value>C</value></includelist></class></DifftoolSpec>"));
}

TEST_P(GrammarTest, AttributesOfListsAndValuesAreIgnored)
{
    EXPECT_EQ("Other exclude A:INCLUDE\n", Read("<DifftoolSpec><class name=\"Other\"><includelist x=\"1\"><value "
                                                "y=\"2\">A</value></includelist></class></DifftoolSpec>"));
}

TEST_P(GrammarTest, TextOutsideValuesIsThrownAway)
{
    EXPECT_EQ("Other exclude A:INCLUDE\n",
              Read("<DifftoolSpec>x<class name=\"Other\">B<includelist>C<value>A</value>D</includelist>E</class>F</DifftoolSpec>"));
}

TEST_P(GrammarTest, EntitiesAndCommentsAreTheHostsBusiness)
{
    EXPECT_EQ("Other exclude A:INCLUDE\n", Read("<DifftoolSpec><class name=\"Othe&#114;\"><includelist><value>&#65;<!-- c "
                                                "--></value></includelist></class></DifftoolSpec>"));
}

TEST_P(GrammarTest, ANestedElementEndsItsValue)
{
    EXPECT_EQ("Other exclude A:INCLUDE\n",
              Read("<DifftoolSpec><class name=\"Other\"><includelist><value>A<x/></value></includelist></class></DifftoolSpec>"));
}

TEST_P(GrammarTest, AClassReadAfterItsAncestorPrevails)
{
    EXPECT_EQ("Base include B:EXCLUDE\n"
              "Sub exclude final B:EXCLUDE C:INCLUDE\n",
              Read("<DifftoolSpec>"
                   "<class name=\"Base\" default=\"include\"><excludelist><value>B</value></excludelist></class>"
                   "<class name=\"Sub\"><includelist><value>C</value></includelist></class></DifftoolSpec>"));
}

TEST_P(GrammarTest, AnAncestorReadAfterItsSubclassOverridesIt)
{
    EXPECT_EQ("Base include B:EXCLUDE\n"
              "Sub include B:EXCLUDE C:INCLUDE -Id\n",
              Read("<DifftoolSpec>"
                   "<class name=\"Sub\" excludekeys=\"Id\"><includelist><value>B</value><value>C</value></includelist></class>"
                   "<class name=\"Base\" default=\"include\"><excludelist><value>B</value></excludelist></class></DifftoolSpec>"));
}

TEST_P(GrammarTest, TheSecondElementOfAClassMergesAndTheThirdDoesNothing)
{
    EXPECT_EQ(
        "Other exclude final A:EXCLUDE Id:INCLUDE -Id\n",
        Read("<DifftoolSpec>"
             "<class name=\"Other\" default=\"include\" excludekeys=\"Id\"><includelist><value>A</value></includelist></class>"
             "<class name=\"Other\" excludekeys=\"A\"><includelist><value>Id</value></includelist>"
             "<excludelist><value>A</value></excludelist></class>"
             "<class name=\"Other\" default=\"include\"><includelist><value>A</value></includelist></class>"
             "</DifftoolSpec>"));
}

TEST_P(GrammarTest, AClassThatInheritedIsClosedByItsFirstOwnElement)
{
    EXPECT_EQ("Base include\n"
              "Sub exclude final C:INCLUDE\n",
              Read("<DifftoolSpec><class name=\"Base\" default=\"include\"/>"
                   "<class name=\"Sub\"><includelist><value>C</value></includelist></class>"
                   "<class name=\"Sub\" default=\"include\"><excludelist><value>C</value></excludelist></class></DifftoolSpec>"));
}

TEST_P(GrammarTest, ExcludedKeysReachTheCopiesThatSubclassesStartWith)
{
    EXPECT_EQ(
        "Base exclude -Id\n"
        "Sub exclude final -Id\n",
        Read("<DifftoolSpec><class name=\"Base\" excludekeys=\"Id\"/><class name=\"Sub\" excludekeys=\"Name\"/></DifftoolSpec>"));
}

}  // namespace
}  // namespace NORVZEL20
