// A whole namespace, from a server whose answers are scripted.
#include "client/wbem/FindNamespaces.h"
#include "client/wbem/TNamespaceCollector.h"
#include "embedded/cimxml/TCimXmlWriter.h"
#include "tests/client/wbem/TServerFixture.h"

namespace NORVZEL20 {
namespace {

const char kKeyOfClass[] =
    "<PROPERTY NAME=\"Id\" TYPE=\"uint32\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>";

std::string Class(const std::string& name, const std::string& super = "", bool isAbstract = false)
{
    return "<CLASS NAME=\"" + name + "\"" + (super.empty() ? "" : " SUPERCLASS=\"" + super + "\"") + ">" +
           (isAbstract ? "<QUALIFIER NAME=\"Abstract\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER>" : "") +
           (super.empty() ? kKeyOfClass : "") + "</CLASS>";
}

std::string Instance(const std::string& cls, const std::string& id)
{
    return "<INSTANCE CLASSNAME=\"" + cls + "\"><PROPERTY NAME=\"Id\" TYPE=\"uint32\"><VALUE>" + id +
           "</VALUE></PROPERTY></INSTANCE>";
}

std::string Named(const std::string& cls, const std::string& id)
{
    return "<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME=\"" + cls + "\"><KEYBINDING NAME=\"Id\"><KEYVALUE VALUETYPE=\"numeric\">" +
           id + "</KEYVALUE></KEYBINDING></INSTANCENAME>" + Instance(cls, id) + "</VALUE.NAMEDINSTANCE>";
}

std::string WithPath(const std::string& cls, const std::string& id)
{
    return "<VALUE.INSTANCEWITHPATH><INSTANCEPATH><NAMESPACEPATH><HOST>array</HOST><LOCALNAMESPACEPATH><NAMESPACE "
           "NAME=\"root\"/><NAMESPACE"
           " NAME=\"x\"/></LOCALNAMESPACEPATH></NAMESPACEPATH><INSTANCENAME CLASSNAME=\"" +
           cls + "\"><KEYBINDING NAME=\"Id\"><KEYVALUE VALUETYPE=\"numeric\">" + id +
           "</KEYVALUE></KEYBINDING></INSTANCENAME></INSTANCEPATH>" + Instance(cls, id) + "</VALUE.INSTANCEWITHPATH>";
}

class WbemCollectorTest : public TServerFixture {
  public:
    WbemCollectorTest& Declares(const std::string& classes)
    {
        fTransport.ThenAnswer(AnswerTo("EnumerateClasses", "<IRETURNVALUE>" + classes + "</IRETURNVALUE>"));
        fTransport.ThenAnswer(ErrorAnswer("EnumerateQualifiers", "7", "none here"));
        return *this;
    }
    WbemCollectorTest& Opens(const std::string& members, const std::string& context)
    {
        return Gives("OpenEnumerateInstances", members, context);
    }
    WbemCollectorTest& Pulls(const std::string& members, const std::string& context)
    {
        return Gives("PullInstancesWithPath", members, context);
    }
    /// An empty context ends the sequence.
    WbemCollectorTest& Gives(const std::string& operation, const std::string& members, const std::string& context)
    {
        fTransport.ThenAnswer(AnswerTo(operation, "<IRETURNVALUE>" + members +
                                                      "</IRETURNVALUE><PARAMVALUE NAME=\"EnumerationContext\"><VALUE>" + context +
                                                      "</VALUE></PARAMVALUE><PARAMVALUE NAME=\"EndOfSequence\"><VALUE>" +
                                                      (context.empty() ? "TRUE" : "FALSE") + "</VALUE></PARAMVALUE>"));
        return *this;
    }
    WbemCollectorTest& Lists(const std::string& members)
    {
        fTransport.ThenAnswer(AnswerTo("EnumerateInstances", "<IRETURNVALUE>" + members + "</IRETURNVALUE>"));
        return *this;
    }
    WbemCollectorTest& Refuses(const std::string& operation, const std::string& code, const std::string& words)
    {
        fTransport.ThenAnswer(ErrorAnswer(operation, code, words));
        return *this;
    }

    /// What was collected: instances by class, and what was not; or the message.
    std::string Collect()
    {
        try {
            const TNamespaceCollector::TResult result = TNamespaceCollector(Server(), "root/x").Collect();
            EXPECT_EQ("root/x", result.loaded.namespaceName);
            EXPECT_TRUE(result.loaded.namesNamespace);
            fHost = result.loaded.host;
            std::string text;
            for (const boost::shared_ptr<TInMemClass>& cls : result.ns->GetClasses()) {
                text += cls->GetName() + " " + std::to_string(cls->GetInstanceCount()) + "\n";
            }
            for (const TNotCollected& entry : FindNotCollected(*result.ns)) {
                text += "no " + entry.kind + " of";
                for (const std::string& subject : entry.subjects) {
                    text += " " + subject;
                }
                text += " (" + std::to_string(entry.count) + "): " + entry.reason + "\n";
            }
            return text;
        } catch (const TClientError& error) {
            return std::string("error: ") + error.what();
        }
    }

    std::string fHost;
};

TEST_F(WbemCollectorTest, EachClassWithoutASuperclassIsReadByPull)
{
    Declares(Class("A") + Class("B", "A") + Class("C"))
        .Opens(WithPath("A", "1"), "7")
        .Pulls(WithPath("B", "2") + WithPath("B", "3"), "8")
        .Pulls("", "")
        .Opens("", "");
    EXPECT_EQ("A 1\nB 2\nC 0\n", Collect());
    EXPECT_EQ("EnumerateClasses\nEnumerateQualifiers\nOpenEnumerateInstances A\nPullInstancesWithPath 7\nPullInstancesWithPath 8\n"
              "OpenEnumerateInstances C\n",
              fTransport.fCalls);
    EXPECT_EQ("array", fHost);
    EXPECT_EQ(3u, Server().GetCounts().finished);
    EXPECT_EQ(3u, Server().GetCounts().classes);
}

TEST_F(WbemCollectorTest, AServerWithoutPullIsAskedForItOnce)
{
    Declares(Class("A") + Class("C")).Refuses("OpenEnumerateInstances", "7", "").Lists(Named("A", "1")).Lists(Named("C", "1"));
    EXPECT_EQ("A 1\nC 1\n", Collect());
    EXPECT_EQ("EnumerateClasses\nEnumerateQualifiers\nOpenEnumerateInstances A\nEnumerateInstances A\nEnumerateInstances C\n",
              fTransport.fCalls);
}

TEST_F(WbemCollectorTest, SoIsOneThatDoesNotKnowPullAtAll)
{
    Declares(Class("A"));
    fTransport.ThenStatus(501, "Not Implemented");
    Lists(Named("A", "1"));
    EXPECT_EQ("A 1\n", Collect());
}

TEST_F(WbemCollectorTest, AFailingProviderCostsItsOwnClassesOnly)
{
    Declares(Class("Top", "", true) + Class("Disk", "Top") + Class("Fan", "Top") + Class("Fast", "Fan") + Class("Volume", "Top"))
        .Refuses("OpenEnumerateInstances", "1", "crashed")  // Top
        .Opens(WithPath("Disk", "1"), "")
        .Refuses("OpenEnumerateInstances", "1", "crashed")  // Fan
        .Refuses("OpenEnumerateInstances", "2", "not you")  // Fast
        .Opens(WithPath("Volume", "2"), "");
    EXPECT_EQ("Top 0\nDisk 1\nFan 0\nFast 0\nVolume 1\nKALMO_NotCollected 2\n"
              "no instances of Fan itself (1): CIM_ERR_FAILED (1), \"crashed\"\n"
              "no instances of Fast (1): CIM_ERR_ACCESS_DENIED (2), \"not you\"\n",
              Collect());
    EXPECT_EQ(5u, Server().GetCounts().finished);
}

TEST_F(WbemCollectorTest, ClassesThatFailForOneReasonStandTogether)
{
    Declares(Class("A") + Class("B") + Class("C"))
        .Opens(WithPath("A", "1"), "")
        .Refuses("OpenEnumerateInstances", "1", "crashed")
        .Refuses("OpenEnumerateInstances", "1", "crashed");
    EXPECT_EQ("A 1\nB 0\nC 0\nKALMO_NotCollected 1\nno instances of B C (2): CIM_ERR_FAILED (1), \"crashed\"\n", Collect());
}

TEST_F(WbemCollectorTest, AnEnumerationThatFailsIsClosedAndNothingOfItIsKept)
{
    Declares(Class("A") + Class("B"))
        .Opens(WithPath("A", "1"), "7")
        .Refuses("PullInstancesWithPath", "1", "crashed")
        .Refuses("CloseEnumeration", "21", "")
        .Opens(WithPath("B", "1"), "");
    EXPECT_EQ("A 0\nB 1\nKALMO_NotCollected 1\nno instances of A (1): CIM_ERR_FAILED (1), \"crashed\"\n", Collect());
    EXPECT_EQ("EnumerateClasses\nEnumerateQualifiers\nOpenEnumerateInstances A\nPullInstancesWithPath 7\nCloseEnumeration 7\n"
              "OpenEnumerateInstances B\n",
              fTransport.fCalls);
}

TEST_F(WbemCollectorTest, AnAnswerToPullThatIsLostBeginsTheEnumerationAnew)
{
    Declares(Class("A")).Opens(WithPath("A", "1"), "7");
    fTransport.ThenFail(TWbemFault::kBroken, "cut");
    Opens(WithPath("A", "1"), "8").Pulls(WithPath("A", "2"), "");
    EXPECT_EQ("A 2\n", Collect());
    EXPECT_EQ("500 ", fPauses);
}

TEST_F(WbemCollectorTest, ASequenceWithoutEndIsLeft)
{
    Declares(Class("A") + Class("B")).Opens("", "7");
    for (int i = 0; i < 1000; ++i) {
        Pulls("", "7");
    }
    fTransport.ThenAnswer(AnswerTo("CloseEnumeration", ""));
    Opens(WithPath("B", "1"), "");
    EXPECT_EQ("A 0\nB 1\nKALMO_NotCollected 1\nno instances of A (1): found 1001 answers without instances in a row\n", Collect());
}

TEST_F(WbemCollectorTest, ASequenceThatCannotGoOnIsLeft)
{
    Declares(Class("A") + Class("B"));
    fTransport.ThenAnswer(AnswerTo("OpenEnumerateInstances", "<IRETURNVALUE/>"));
    Opens(WithPath("B", "1"), "");
    EXPECT_EQ("A 0\nB 1\nKALMO_NotCollected 1\n"
              "no instances of A (1): found no EnumerationContext, expected one or the end of the sequence\n",
              Collect());
}

TEST_F(WbemCollectorTest, AnAnswerThatDoesNotLoadIsNotCollected)
{
    Declares(Class("A") + Class("B")).Opens(WithPath("A", "no number"), "").Opens(WithPath("B", "1"), "");
    EXPECT_EQ("A 0\nB 1\nKALMO_NotCollected 1\n"
              "no instances of A (1): found \"no number\" in property \"Id\" of class \"A\", expected a number\n",
              Collect());
}

TEST_F(WbemCollectorTest, NothingAtAllIsAnError)
{
    Declares(Class("A")).Refuses("OpenEnumerateInstances", "1", "crashed");
    EXPECT_EQ("error: https://array1:5989: nothing could be collected from root/x; A: CIM_ERR_FAILED (1), \"crashed\"", Collect());
}

TEST_F(WbemCollectorTest, WithoutDeclarationsThereIsNoInventory)
{
    Refuses("EnumerateClasses", "1", "no repository");
    EXPECT_EQ("error: https://array1:5989: EnumerateClasses of root/x: CIM_ERR_FAILED (1), \"no repository\"", Collect());
}

TEST_F(WbemCollectorTest, ANamespaceThatVanishesEndsTheCollection)
{
    Declares(Class("A")).Refuses("OpenEnumerateInstances", "3", "");
    EXPECT_EQ("error: https://array1:5989: OpenEnumerateInstances of A: CIM_ERR_INVALID_NAMESPACE (3)", Collect());
}

TEST_F(WbemCollectorTest, SoDoesAServerThatVanishes)
{
    Declares(Class("A") + Class("B"));
    for (int i = 0; i < 4; ++i) {
        fTransport.ThenFail(TWbemFault::kUnreachable, "refused");
    }
    EXPECT_EQ("error: https://array1:5989: refused", Collect());
}

TEST_F(WbemCollectorTest, InstancesWithoutANameOfTheirNamespaceStandInTheOneThatWasAsked)
{
    const std::string reference = "<CLASS NAME=\"L\"><PROPERTY.REFERENCE NAME=\"To\" REFERENCECLASS=\"A\"><QUALIFIER NAME=\"Key\" "
                                  "TYPE=\"boolean\"><VALUE>TRUE</VALUE>"
                                  "</QUALIFIER></PROPERTY.REFERENCE></CLASS>";
    const std::string foreign =
        "<INSTANCE CLASSNAME=\"L\"><PROPERTY.REFERENCE "
        "NAME=\"To\"><VALUE.REFERENCE><LOCALINSTANCEPATH><LOCALNAMESPACEPATH><NAMESPACE"
        " NAME=\"other\"/></LOCALNAMESPACEPATH><INSTANCENAME CLASSNAME=\"A\"><KEYBINDING NAME=\"Id\"><KEYVALUE "
        "VALUETYPE=\"numeric\">1</KEYVALUE>"
        "</KEYBINDING></INSTANCENAME></LOCALINSTANCEPATH></VALUE.REFERENCE></PROPERTY.REFERENCE></INSTANCE>";
    Declares(Class("A") + reference).Refuses("OpenEnumerateInstances", "7", "").Lists("").Lists(foreign);
    EXPECT_EQ("A 0\nL 1\n", Collect());
}

TEST_F(WbemCollectorTest, NamespacesAreThoseOfTheFirstInteropThatKnows)
{
    const auto name = [](const std::string& text) {
        return "<INSTANCENAME CLASSNAME=\"CIM_Namespace\"><KEYBINDING NAME=\"Name\"><KEYVALUE>" + text +
               "</KEYVALUE></KEYBINDING></INSTANCENAME>";
    };
    Refuses("EnumerateInstanceNames", "3", "");
    fTransport.ThenAnswer(AnswerTo("EnumerateInstanceNames",
                                   "<IRETURNVALUE>" + name("root/cimv2") + name("ROOT/cimv2") + name("/a") + "</IRETURNVALUE>"));
    EXPECT_EQ((std::vector<std::string>{"a", "interop", "root/cimv2"}), FindNamespaces(Server()));
}

TEST_F(WbemCollectorTest, NamespacesAreFoundDownwardsFromRootOtherwise)
{
    const auto names = [this](const std::vector<std::string>& texts) {
        std::string members;
        for (const std::string& text : texts) {
            members += "<INSTANCENAME CLASSNAME=\"__Namespace\"><KEYBINDING NAME=\"Name\"><KEYVALUE>" + text +
                       "</KEYVALUE></KEYBINDING></INSTANCENAME>";
        }
        fTransport.ThenAnswer(AnswerTo("EnumerateInstanceNames", "<IRETURNVALUE>" + members + "</IRETURNVALUE>"));
    };
    for (int i = 0; i < 4; ++i) {
        Refuses("EnumerateInstanceNames", "5", "");
    }
    names({"b", "a"});
    names({"below"});
    names({});
    names({});
    EXPECT_EQ((std::vector<std::string>{"root/a", "root/a/below", "root/b"}), FindNamespaces(Server()));
}

TEST_F(WbemCollectorTest, AServerMayNotSayItsNamespaces)
{
    for (int i = 0; i < 5; ++i) {
        Refuses("EnumerateInstanceNames", "5", "");
    }
    EXPECT_EQ(std::vector<std::string>(), FindNamespaces(Server()));
}

}  // namespace
}  // namespace NORVZEL20
