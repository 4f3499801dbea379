// Warnings are about rules that the plug-in accepts, so documents are written as text and read as the client reads them.

#include "client/rules/TRuleWarnings.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "client/rules/SayRuleWarnings.h"
#include "client/rules/TRulesParser.h"
#include "client/rules/TSyntaxParser.h"
#include "embedded/store/TInMemNamespace.h"
#include "tests/client/TFakeConsole.h"
#include "tests/support/TNamespaceBuilder.h"

namespace NORVZEL20 {
namespace {

/// A small tree: A (key K, p, q) above B (key L) and C, B above D; X stands alone.
class RuleWarningsTest : public ::testing::Test {
  protected:
    RuleWarningsTest()
    {
        TNamespaceBuilder(fSchema)
            .Class("A", "", {TNamespaceBuilder::Key("K"), TNamespaceBuilder::Property("p"), TNamespaceBuilder::Property("q")})
            .Class("B", "A", {TNamespaceBuilder::Key("L")})
            .Class("C", "A", {})
            .Class("D", "B", {})
            .Class("X", "", {TNamespaceBuilder::Key("Id")});
    }

    /// The warnings about a file with these elements, one on each line, from line 1.
    std::string Warnings(const std::vector<std::string>& elements) const
    {
        TRulesParser parser(fSchema);
        return WarningsOf(parser, elements, fSchema, true);
    }

    /// Those of a reader that has no schema.
    static std::string WarningsWithoutSchema(const std::vector<std::string>& elements)
    {
        TSyntaxParser parser;
        return WarningsOf(parser, elements, parser.GetNamedClasses(), false);
    }

    struct TRow {
        std::vector<std::string> elements;
        std::string warnings;
    };

    void ExpectWarnings(const std::vector<TRow>& rows) const
    {
        for (const TRow& row : rows) {
            EXPECT_EQ(row.warnings, Warnings(row.elements)) << Text(row.elements);
        }
    }

    static std::string Text(const std::vector<std::string>& elements)
    {
        std::string text = "<DifftoolSpec>";
        for (const std::string& element : elements) {
            text += element + "\n";
        }
        return text + "</DifftoolSpec>";
    }

    boost::shared_ptr<TInMemNamespace> fSchema = TInMemNamespace::Create("root/cimv2");

  private:
    static std::string WarningsOf(TRulesParser& parser, const std::vector<std::string>& elements,
                                  const boost::shared_ptr<TInMemNamespace>& schema, bool isSchemaKnown)
    {
        parser.Read({"R", Text(elements), false});
        const TRuleTrace trace(parser.GetDocument(), schema);
        const TRuleWarnings warnings(parser.GetDocument(), trace, schema, isSchemaKnown);
        std::string text;
        for (const TRuleWarnings::TWarning& warning : warnings.Get()) {
            text += std::to_string(warning.line) + " " + warning.text + "\n";
        }
        return text;
    }
};

const char kLateKeys[] =
    "2 excludekeys of class B has no effect: the class already has the rules of its ancestor A (line 1); put an element for B with "
    "excludekeys alone before that one, and keep default and lists here\n";
const char kOverruled[] =
    "1 the element for class B is read before that of its ancestor A (line 2), whose default and lists replace its own; keep "
    "excludekeys alone here, and put default and lists into a second element for B after that one\n";

TEST_F(RuleWarningsTest, OrdinaryRulesGetNone)
{
    const std::vector<std::string> rows[] = {
        {"<class name='A' default='include'/>", "<class name='B' default='exclude'/>", "<class name='D' default='include'/>"},
        {"<class name='C' default='exclude'/>", "<class name='C' default='include'/>"},
        {"<class name='A'><includelist><value>p</value></includelist></class>"},
        {"<class name='&lt;root&gt;' default='include'/>"},
        {"<class name='&lt;root&gt;' default='include' excludekeys='K L Id'/>"},
        {"<class name='B' default='include' excludekeys='L K'/>"},
        // A key of a class below.
        {"<class name='A' default='include' excludekeys='L'/>"},
        // Keys alone, before the ancestor that gives the default.
        {"<class name='B' excludekeys='L'/>", "<class name='A' default='include'/>"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ("", Warnings(row)) << Text(row);
        EXPECT_EQ("", WarningsWithoutSchema(row)) << Text(row);
    }
}

/// Each advice is followed in turn; it ends where nothing is left to warn of, whichever of the two comes first.
TEST_F(RuleWarningsTest, TheAdviceAboutOrderLeadsToRulesWithoutWarnings)
{
    const std::string ancestor = "<class name='A' default='include'/>";
    const std::string whole =
        "<class name='B' default='exclude' excludekeys='L'><includelist><value>p</value></includelist></class>";
    EXPECT_EQ(kLateKeys, Warnings({ancestor, whole}));
    EXPECT_EQ(kOverruled, Warnings({whole, ancestor}));
    const std::string rest = "<class name='B' default='exclude'><includelist><value>p</value></includelist></class>";
    EXPECT_EQ("", Warnings({"<class name='B' excludekeys='L'/>", ancestor, rest}));
}

TEST_F(RuleWarningsTest, AnElementOnTheWrongSideOfItsAncestorGetsOne)
{
    ExpectWarnings({
        {{"<class name='A' default='include'/>", "<class name='B' excludekeys='L'/>"},
         "2 excludekeys of class B has no effect: the class already has the rules of its ancestor A (line 1); put this element "
         "before that one\n"
         "2 class B is not compared: this element has no default, which means exclude, and no list includes a property; write "
         "default=\"include\" or default=\"exclude\"\n"},
        {{"<class name='D' default='include'/>", "<class name='A' default='exclude'/>"},
         "1 the element for class D is read before that of its ancestor A (line 2), whose default and lists replace its own; put "
         "it after that one\n"},
        // Said once, of the element that decides in the end.
        {{"<class name='D' default='include'/>", "<class name='B' default='exclude'/>", "<class name='A' default='exclude'/>",
          "<class name='A' default='include'/>"},
         "1 the element for class D is read before that of its ancestor A (line 4), whose default and lists replace its own; put "
         "it after that one\n"
         "2 the element for class B is read before that of its ancestor A (line 4), whose default and lists replace its own; put "
         "it after that one\n"},
        // The ancestor came later, but then the class again.
        {{"<class name='D' default='include'/>", "<class name='A' default='exclude'/>", "<class name='D' default='include'/>"}, ""},
    });
}

TEST_F(RuleWarningsTest, AnElementThatComesTooLateGetsOne)
{
    ExpectWarnings({
        {{"<class name='C' default='include'/>", "<class name='C' default='include'/>", "<class name='C' default='include'/>"},
         "3 this element for class C has no effect: the rules of the class were final after line 2; put what is meant there\n"},
        {{"<class name='A' default='include'/>", "<class name='B' default='include'/>",
          "<class name='B' excludekeys='nix'><includelist><value>p</value><value>p</value></includelist></class>"},
         "3 this element for class B has no effect: the rules of the class were final after line 2; put what is meant there\n"},
        {{"<class name='C' default='include'/>", "<class name='C' default='include' excludekeys='K'/>"},
         "2 excludekeys of class C has no effect: the class has the keys of its first element, at line 1; name them there\n"},
    });
}

TEST_F(RuleWarningsTest, KeysAndNamesThatDoNotApplyGetOne)
{
    ExpectWarnings({
        {{"<class name='A' default='include' excludekeys='p'/>"}, "1 excluded key p is not a key of class A\n"},
        {{"<class name='A' default='include' excludekeys='k'/>"},
         "1 excluded key k of class A is declared as K; letter case counts in rules, so it still counts as a key\n"},
        // Only B has the key, and B has its keys from line 1.
        {{"<class name='B' excludekeys='K'/>", "<class name='A' default='include' excludekeys='L'/>"},
         "2 excluded key L is not a key of class A\n"},
        {{"<class name='a' default='include'/>"},
         "1 class a is declared as A; letter case counts in rules, so this element does not apply to that class\n"},
        {{"<class name='A' default='include'><excludelist><value>P</value><value>q</value><value>q</value><value>q</value>"
          "</excludelist></class>"},
         "1 property q of class A is already listed in this element; the first listing counts\n"
         "1 property P of class A is declared as p; letter case counts in rules\n"},
    });
}

TEST_F(RuleWarningsTest, AnElementThatComparesNothingGetsOne)
{
    ExpectWarnings({
        {{"<class name='A'/>", "<class name='X' default='include'/>"},
         "1 class A is not compared: this element has no default, which means exclude, and no list includes a property; write "
         "default=\"include\" or default=\"exclude\"\n"},
        {{"<class name='A'><excludelist><value>p</value></excludelist><includelist><value>p</value></includelist></class>"},
         "1 property p of class A is already listed in this element; the first listing counts\n"
         "1 class A is not compared: this element has no default, which means exclude, and no list includes a property; write "
         "default=\"include\" or default=\"exclude\"\n"},
    });
}

TEST_F(RuleWarningsTest, ATimeOfCollectionThatIsListedInVainIsNamed)
{
    TNamespaceBuilder(fSchema)
        .Class("T", "", {TNamespaceBuilder::Key("K"), TNamespaceBuilder::Property("DateTimeOfCollection")})
        .Class("U", "T", {});
    const std::string list = "<includelist><value>DateTimeOfCollection</value></includelist></class>";
    const std::string warning =
        " property DateTimeOfCollection of class T is never compared if the default is include, so this listing has no effect; "
        "write default=\"exclude\" and list all that is to be compared\n";
    const struct {
        std::vector<std::string> elements;
        std::string warnings;
    } rows[] = {
        {{"<class name='T' default='include'>" + list}, "1" + warning},
        {{"<class name='T' default='include'>\n" + list}, "2" + warning},
        {{"<class name='T' default='exclude'>" + list}, ""},
        {{"<class name='T'>" + list}, ""},
        {{"<class name='T' default='include'><excludelist><value>DateTimeOfCollection</value></excludelist></class>"}, ""},
        // The later element decides the default.
        {{"<class name='T' default='exclude'>" + list, "<class name='T' default='include'/>"}, "1" + warning},
        {{"<class name='T' default='include'>" + list, "<class name='T' default='exclude'/>"}, ""},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.warnings, Warnings(row.elements)) << Text(row.elements);
    }
}

TEST_F(RuleWarningsTest, RulesThatIncludeNothingAreNamed)
{
    const std::string warning =
        "1 these rules compare nothing, because no element includes anything; write default=\"include\" or an includelist\n";
    const std::string excluded = "<excludelist><value>K</value></excludelist></class>";
    for (const std::vector<std::string>& elements :
         {std::vector<std::string>(), {"<class name='A' default='exclude'/>"}, {"<class name='A' default='exclude'>" + excluded}}) {
        EXPECT_EQ(warning, Warnings(elements)) << Text(elements);
        EXPECT_EQ(warning, WarningsWithoutSchema(elements)) << Text(elements);
    }
    EXPECT_EQ("", Warnings({"<class name='A' default='exclude'/>", "<class name='X' default='include'/>"}));
    EXPECT_EQ("", Warnings({"<class name='A' default='exclude'><includelist><value>p</value></includelist></class>"}));
}

/// Such a comparison would fail, so it is refused; check says it before.
TEST_F(RuleWarningsTest, KeysOfTheComparisonsOwnRecordsAreNamed)
{
    TNamespaceBuilder(fSchema).Class("KALMO_Delta", "", {TNamespaceBuilder::Key("DeltaID")});
    EXPECT_EQ("", Warnings({"<class name='KALMO_Delta' default='include'/>"}));
    EXPECT_EQ("1 rules for class KALMO_Delta cannot have excludekeys, because the comparison keeps its own records in a class of "
              "that name; "
              "leave out excludekeys, or make both results with -o ndjson and compare those with diff\n",
              Warnings({"<class name='KALMO_Delta' default='include' excludekeys='DeltaID'/>"}));
}

TEST_F(RuleWarningsTest, WithoutASchemaOnlyWhatHoldsForEverySchemaIsSaid)
{
    EXPECT_EQ("",
              WarningsWithoutSchema({"<class name='B' default='include'/>", "<class name='A' default='exclude' excludekeys='nix'/>",
                                     "<class name='a' excludekeys='K'/>", "<class name='N'/>"}));
    EXPECT_EQ("1 property p of class N is already listed in this element; the first listing counts\n"
              "2 excludekeys of class N has no effect: the class has the keys of its first element, at line 1; name them there\n"
              "3 this element for class N has no effect: the rules of the class were final after line 2; put what is meant there\n",
              WarningsWithoutSchema({"<class name='N'><includelist><value>p</value><value>p</value></includelist></class>",
                                     "<class name='N' excludekeys='k'/>", "<class name='N'/>"}));
}

TEST_F(RuleWarningsTest, LongNamesAreShortened)
{
    const std::string name(100, 'x');
    EXPECT_EQ("1 excluded key " + name.substr(0, 80) + "... is not a key of class X\n",
              Warnings({"<class name='X' default='include' excludekeys='" + name + "'/>"}));
}

TEST_F(RuleWarningsTest, OfVeryManyOnlyTheFirstAreSaid)
{
    const auto said = [this](std::size_t count) {
        TRulesParser parser(fSchema);
        parser.Read({"R", Text(std::vector<std::string>(count, "<class name='X' default='include'/>")), false});
        TFakeConsole console;
        SayRuleWarnings(console, "R", parser.GetDocument(), fSchema, "; see there");
        return console.fErr;
    };
    EXPECT_EQ("", said(2));
    EXPECT_EQ("cimdelta: R:3: warning: this element for class X has no effect: the rules of the class were final after line 2; put "
              "what is meant there\n",
              said(3));
    const std::string ten = said(12);
    EXPECT_EQ(10, std::count(ten.begin(), ten.end(), '\n')) << ten;
    EXPECT_EQ(0u, said(13).find(ten));
    EXPECT_EQ("cimdelta: R: 1 more warning; see there\n", said(13).substr(ten.size()));
    EXPECT_EQ("cimdelta: R: 88 more warnings; see there\n", said(100).substr(ten.size()));
}

}  // namespace
}  // namespace NORVZEL20
