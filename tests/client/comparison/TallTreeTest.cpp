// Class trees that are taller, and classes that are wider, than any schema's.
#include "client/inventory/CollectObjects.h"
#include "client/rules/TRuleTrace.h"
#include "embedded/store/TInMemNamespace.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

using TallTreeTest = TClientFixture;

std::string Name(std::size_t number)
{
    return "C" + std::to_string(number);
}

/// An inventory of the classes from `first` to `last`, each the superclass of the next.
std::string Chain(std::size_t first, std::size_t last)
{
    std::string text = "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>\n<VALUE.OBJECT><CLASS NAME=\"" +
                       Name(first) + "\"/></VALUE.OBJECT>";
    for (std::size_t number = first + 1; number <= last; ++number) {
        text += "\n<VALUE.OBJECT><CLASS NAME=\"" + Name(number) + "\" SUPERCLASS=\"" + Name(number - 1) + "\"/></VALUE.OBJECT>";
    }
    return text + "</DECLGROUP></DECLARATION></CIM>";
}

/// An inventory of one class with `count` properties, numbered from `first` on.
std::string Wide(std::size_t first, std::size_t count)
{
    std::string text = "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP><VALUE.OBJECT><CLASS NAME=\"A\">";
    for (std::size_t number = first; number < first + count; ++number) {
        text += "<PROPERTY NAME=\"P" + std::to_string(number) + "\" TYPE=\"uint8\"/>";
    }
    return text + "</CLASS></VALUE.OBJECT></DECLGROUP></DECLARATION></CIM>";
}

boost::shared_ptr<TInMemNamespace> TallNamespace(std::size_t height)
{
    const boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
    boost::shared_ptr<TInMemClass> super;
    for (std::size_t number = 0; number < height; ++number) {
        super = ns->AllocateInMemClass(Name(number), super);
        super->AddToNamespace(TCallContext());
    }
    return ns;
}

}  // namespace

/// Neither exceeds the limit alone. Together they do: the top class of the second one is the lowest class of the first.
TEST_F(TallTreeTest, InventoriesWhoseTreesJoinBeyondTheLimitAreRefused)
{
    const std::string lower = Scratch("lower.xml", Chain(0, 600));
    const std::string upper = Scratch("upper.xml", Chain(600, 1200));
    const std::string complaint = Complaint({"compare", "--detail", lower, upper});
    EXPECT_EQ("cimdelta: lower.xml: class C1001 of upper.xml cannot be declared here: it would have more than 1000 superclasses; "
              "flatten the class tree\n",
              Shorten(Shorten(complaint.substr(complaint.rfind("cimdelta: ")), lower, "lower.xml"), upper, "upper.xml"));
}

TEST_F(TallTreeTest, InventoriesWhosePropertiesJoinBeyondTheLimitAreRefused)
{
    const std::string first = Scratch("first.xml", Wide(0, 600));
    const std::string second = Scratch("second.xml", Wide(600, 600));
    const std::string complaint = Complaint({"compare", "--detail", first, second});
    EXPECT_EQ("cimdelta: second.xml: class A of first.xml cannot be declared here: class A would have more than 1024 properties; "
              "split it\n",
              Shorten(Shorten(complaint.substr(complaint.rfind("cimdelta: ")), first, "first.xml"), second, "second.xml"));
}

TEST_F(TallTreeTest, TreesThatJoinWithinTheLimitAreCompared)
{
    Run({"compare", "--detail", "--allow-empty", Scratch("a.xml", Chain(0, 600)), Scratch("b.xml", Chain(600, 1000))});
    EXPECT_EQ(0, fStatus) << fErr;
}

TEST_F(TallTreeTest, WalkingTakesNoStack)
{
    const boost::shared_ptr<TInMemNamespace> ns = TallNamespace(100000);
    const auto classes = AllClassesOf(*ns);
    ASSERT_EQ(100000U, classes.size());
    EXPECT_EQ("C99999", classes.back()->GetName(TCallContext()));
}

TEST_F(TallTreeTest, RulesFlowDownToTheLimit)
{
    TRulesDocument document;
    document.elements.emplace_back();
    document.elements.back().className = "C0";
    document.elements.back().defaultTreatment = TCIMDiffEngine::INCLUDE;
    const boost::shared_ptr<TInMemNamespace> ns = TallNamespace(1001);
    EXPECT_EQ("C0", TRuleTrace(document, ns).Find("C1000").byDefault.fromClass);
}

}  // namespace NORVZEL20
