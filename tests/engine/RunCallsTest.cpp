#include "tests/engine/TEngineFixture.h"
#include "tests/support/Dump.h"

namespace NORVZEL20 {
namespace {

// All calls of a whole run on the host, in order, with their contexts.
class RunCallsTest : public testing::TestWithParam<EHost> {
  protected:
    RunCallsTest() : fComparison(GetParam()) {}

    TNamespaceBuilder& Namespace(std::size_t index)
    {
        for (; fDeclared <= index; ++fDeclared) {
            fComparison.Namespace(fDeclared).Class(
                "Disk", "", {TNamespaceBuilder::Key("Id"), TNamespaceBuilder::Property("Size", TCIMValue::TCIMType::kUint32)});
        }
        return fComparison.Namespace(index);
    }

    void Disk(std::size_t index, const std::string& id, unsigned int size)
    {
        Namespace(index).Instance("Disk", {{"Id", id}, {"Size", size}});
    }

    void Rules(const std::string& attributes, const std::string& inner = "")
    {
        fComparison.Rules("<DifftoolSpec><class name=\"Disk\" " + attributes + ">" + inner + "</class></DifftoolSpec>");
    }

    std::string CallsOfRun()
    {
        fComparison.Prepare();
        fComparison.GetWatch().Forget();
        EXPECT_EQ("", fComparison.Run());
        return fComparison.GetWatch().TakeText();
    }

    TCapturingLogger fLog;
    TComparisonRun fComparison;

  private:
    std::size_t fDeclared = 0;
};

INSTANTIATE_TEST_SUITE_P(Hosts, RunCallsTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

// The lines of a call on an object, each `object.call`.
std::string Calls(const std::string& object, const std::vector<std::string>& calls)
{
    std::string text;
    for (const auto& call : calls) {
        text += object + "." + call + "\n";
    }
    return text;
}

// The check of the operating systems. It reads the first instance of the reference again for each namespace.
std::string SystemCheck(const std::vector<std::string>& namespaces)
{
    std::string text;
    for (const auto& ns : namespaces) {
        text += ns + ".GetClass(\"KALMO_OperatingSystem\") {}\n";
        text += ns + ":KALMO_OperatingSystem.EnumerateInstances(false) {}\n";
        text += Calls("ns0:KALMO_OperatingSystem.Name=\"os\"", {"GetProperty(\"OSType\") {}", "OSType.GetValue() {}"});
    }
    return text;
}

// A class element without lists.
const char* const kRulesRead = "ns0.GetClass(\"Disk\") {}\n"
                               "ns0.GetClass(\"Disk\") {}\n"
                               "ns0:Disk.EnumerateSubClasses(false) {}\n";

// The walk up to Disk. The rules compare nothing of the operating system.
const char* const kWalk = "ns0.GetClass(\"<root>\") {}\n"
                          "ns0:<root>.EnumerateSubClasses(false) {}\n"
                          "ns0:KALMO_OperatingSystem.GetName() {}\n"
                          "ns0:KALMO_OperatingSystem.EnumerateSubClasses(false) {}\n"
                          "ns0:Disk.GetName() {}\n";

const char* const kAllProperties = "ns0:Disk.EnumeratePropertyDecls() {}\n"
                                   "ns0:Disk.Id.Decl.GetName() {}\n"
                                   "ns0:Disk.Size.Decl.GetName() {}\n";

const char* const kEndOfWalk = "ns0:Disk.EnumerateSubClasses(false) {}\n";

// How the key of a disk is read.
std::string Key(const std::string& ns, const std::string& id)
{
    const std::string disk = ns + ":Disk.Id=\"" + id + "\"";
    return disk + ".GetClass() {}\n" + ns + ":Disk.EnumerateKeyNames() {}\n" +
           Calls(disk, {"GetClass() {}", "GetProperty(\"Id\") {}", "Id.GetValue() {}"});
}

// How one property of two disks is read.
std::string Read(const std::string& id, const std::string& ns, const std::string& name)
{
    const std::string disk = ":Disk.Id=\"" + id + "\".";
    return "ns0" + disk + "GetProperty(\"" + name + "\") {}\n" +  //
           ns + disk + "GetProperty(\"" + name + "\") {}\n" +     //
           "ns0" + disk + name + ".GetValue() {}\n" +             //
           ns + disk + name + ".GetValue() {}\n";
}

const std::string kClassRecord = "store.GetClass(\"KALMO_DeltaClass\") {}\n"
                                 "store:KALMO_DeltaClass.AllocateInstance() {}\n"
                                 "store:new KALMO_DeltaClass.GetProperty(\"ClassName\") {}\n"
                                 "store:new KALMO_DeltaClass.ClassName.SetValue(\"Disk\") {}\n"
                                 "store:new KALMO_DeltaClass.AddToNamespace() {}\n";

std::string Record(int type, const std::string& instance, const std::string& property, const std::string& indices, int number)
{
    const std::string record = "store:new KALMO_Delta";
    const std::string tie = "store:new KALMO_DeltaClassAssocToDelta";
    return "store.GetClass(\"KALMO_Delta\") {}\n"
           "store:KALMO_Delta.AllocateInstance() {}\n" +
           Calls(record,
                 {"GetProperty(\"Type\") {}", "Type.SetValue(" + std::to_string(type) + ") {}", "GetProperty(\"InstanceName\") {}",
                  "InstanceName.SetValue(\"" + instance + "\") {}", "GetProperty(\"Property\") {}",
                  "Property.SetValue(\"" + property + "\") {}", "GetProperty(\"NamespaceIndices\") {}",
                  "NamespaceIndices.SetValue({" + indices + "}) {}", "AddToNamespace() {}"}) +
           "store.GetClass(\"KALMO_DeltaClassAssocToDelta\") {}\n"
           "store:KALMO_DeltaClassAssocToDelta.AllocateInstance() {}\n"
           "store:new KALMO_DeltaClass.GetReference() {}\n" +
           Calls(tie, {"GetProperty(\"Class\") {}", "Class.SetValue(root/cimv2:KALMO_DeltaClass.DeltaClassID=1) {}"}) +
           "store:new KALMO_Delta.GetReference() {}\n" +
           Calls(tie, {"GetProperty(\"Delta\") {}",
                       "Delta.SetValue(root/cimv2:KALMO_Delta.DeltaID=" + std::to_string(number) + ") {}", "AddToNamespace() {}"});
}

// The calls after the record of an instance that only the reference has, with two namespaces.
std::string Marked(const std::string& id)
{
    return Calls("ns0:Disk.Id=\"" + id + "\"",
                 {"EnumerateProperties() {}", "Id.GetValue() {}", "Id.MarkRemoved()", "Size.GetValue() {}", "Size.MarkRemoved()"});
}

// The calls after the record of an instance that only the other namespace has, with two namespaces.
std::string Copied(const std::string& id, unsigned int size)
{
    const std::string disk = "ns1:Disk.Id=\"" + id + "\"";
    return "ns0:Disk.AllocateInstance() {}\n" +
           Calls(disk, {"EnumerateProperties() {}", "Id.GetValue() {}", "Id.GetPropertyDecl() {}", "Id.Decl.GetName() {}"}) +
           Calls("ns0:new Disk", {"GetProperty(\"Id\") {}", "Id.SetValue(\"" + id + "\") {}"}) +
           Calls(disk, {"Size.GetValue() {}", "Size.GetPropertyDecl() {}", "Size.Decl.GetName() {}"}) +
           Calls("ns0:new Disk",
                 {"GetProperty(\"Size\") {}", "Size.SetValue(" + std::to_string(size) + ") {}", "AddToNamespace() {}"});
}

TEST_P(RunCallsTest, OfTwoNamespaces)
{
    Disk(0, "sda", 100);
    Disk(0, "sdb", 5);
    Disk(1, "sda", 200);
    Disk(1, "sdc", 7);
    Rules("default=\"include\"");
    EXPECT_EQ(SystemCheck({"ns0", "ns0", "ns1"}) + kRulesRead + kWalk + kAllProperties + "ns0:Disk.EnumerateInstances(false) {}\n" +
                  Key("ns0", "sda") + Key("ns0", "sdb") +
                  "ns1.GetClass(\"Disk\") {}\n"
                  "ns1:Disk.EnumerateInstances(false) {}\n" +
                  Key("ns1", "sda") + Read("sda", "ns1", "Id") + Read("sda", "ns1", "Size") +
                  "ns0:Disk.Id=\"sda\".Size.MarkChanged(200)\n" +  //
                  Key("ns1", "sdc") + kClassRecord + Record(1, "Disk.Id=\"sdb\"", "", "1", 1) + Marked("sdb") +
                  "ns1:Disk.EnumerateInstances(false) {}\n" + Key("ns1", "sda") + Key("ns1", "sdc") +
                  Record(2, "Disk.Id=\"sdc\"", "", "1", 2) + Copied("sdc", 7) + Record(4, "Disk.Id=\"sda\"", "Size", "1", 3) +
                  kEndOfWalk,
              CallsOfRun());
}

// The calls after the class record has been added.
std::string OfTheRecords(const std::string& calls)
{
    const std::size_t start = calls.find(kClassRecord);
    return start == std::string::npos ? "no class record" : calls.substr(start + kClassRecord.size());
}

TEST_P(RunCallsTest, OfTwoNamespacesAnInstanceAtATime)
{
    Disk(0, "sda", 1);
    Disk(0, "sdb", 2);
    Disk(1, "sdc", 3);
    Disk(1, "sdd", 4);
    Rules("default=\"include\"");
    EXPECT_EQ(Record(1, "Disk.Id=\"sda\"", "", "1", 1) + Marked("sda") +      //
                  Record(1, "Disk.Id=\"sdb\"", "", "1", 2) + Marked("sdb") +  //
                  "ns1:Disk.EnumerateInstances(false) {}\n" + Key("ns1", "sdc") + Key("ns1", "sdd") +
                  Record(2, "Disk.Id=\"sdc\"", "", "1", 3) + Copied("sdc", 3) +  //
                  Record(2, "Disk.Id=\"sdd\"", "", "1", 4) + Copied("sdd", 4) + kEndOfWalk,
              OfTheRecords(CallsOfRun()));
}

// An absent instance if keys are excluded.
std::string RecordWithAlias(const std::string& id, int number)
{
    const std::string path = "root/cimv2:Disk.Id=\"" + id + "\"";
    return "ns0:Disk.Id=\"" + id + "\".GetReference() {}\n" + "store.GetClass(\"Disk\") {nsIndex=0}\n" +
           (number == 1 ? "ns0.GetClass(\"Disk\") {nsIndex=0}\n" : "") + Record(1, path, "", "1", number);
}

TEST_P(RunCallsTest, OfTwoNamespacesAnInstanceAtATimeWhereKeysAreExcluded)
{
    Disk(0, "sda", 1);
    Disk(0, "sdb", 2);
    Disk(1, "sdc", 3);
    Disk(1, "sdd", 4);
    Rules("default=\"include\" excludekeys=\"Other\"");
    EXPECT_EQ(RecordWithAlias("sda", 1) + Marked("sda") +      //
                  RecordWithAlias("sdb", 2) + Marked("sdb") +  //
                  "ns1:Disk.EnumerateInstances(false) {}\n" + Key("ns1", "sdc") + Key("ns1", "sdd") +
                  Record(2, "Disk.Id=\"sdc\"", "", "1", 3) + Copied("sdc", 3) +  //
                  Record(2, "Disk.Id=\"sdd\"", "", "1", 4) + Copied("sdd", 4) + kEndOfWalk,
              OfTheRecords(CallsOfRun()));
}

TEST_P(RunCallsTest, OfThreeNamespaces)
{
    Disk(0, "sda", 100);
    Disk(0, "sdb", 5);
    Disk(1, "sda", 200);
    Disk(2, "sdb", 5);
    Disk(2, "sdc", 7);
    Rules("default=\"include\"");
    EXPECT_EQ(SystemCheck({"ns0", "ns0", "ns1", "ns2"}) + kRulesRead + kWalk + kAllProperties +
                  "ns0:Disk.EnumerateInstances(false) {}\n" + Key("ns0", "sda") + Key("ns0", "sdb") +
                  "ns1.GetClass(\"Disk\") {}\n"
                  "ns1:Disk.EnumerateInstances(false) {}\n" +
                  Key("ns1", "sda") + Read("sda", "ns1", "Id") + Read("sda", "ns1", "Size") +
                  "ns2.GetClass(\"Disk\") {}\n"
                  "ns2:Disk.EnumerateInstances(false) {}\n" +
                  Key("ns2", "sdb") + Read("sdb", "ns2", "Id") + Read("sdb", "ns2", "Size") + Key("ns2", "sdc") + kClassRecord +
                  Record(1, "Disk.Id=\"sda\"", "", "2", 1) + Record(1, "Disk.Id=\"sdb\"", "", "1", 2) +
                  Record(2, "Disk.Id=\"sdc\"", "", "2", 3) + Record(4, "Disk.Id=\"sda\"", "Size", "1", 4) + kEndOfWalk,
              CallsOfRun());
}

// An alias for a difference: the instance's class is asked for its name, then the delta namespace for its wrapper.
std::string Alias(const std::string& ns, const std::string& id, bool isWrapperThere)
{
    const std::string index = ns.substr(2);
    const std::string disk = ns + ":Disk.Id=\"" + id + "\"";
    return disk + ".GetClass() {}\n" + ns + ":Disk.GetName() {}\n" + disk + ".GetReference() {}\n" +
           "store.GetClass(\"Disk\") {nsIndex=" + index + "}\n" +
           (isWrapperThere ? "" : ns + ".GetClass(\"Disk\") {nsIndex=" + index + "}\n");
}

// The key of a disk whose only key is excluded.
std::string EmptyKey(const std::string& ns, const std::string& id)
{
    const std::string disk = ns + ":Disk.Id=\"" + id + "\"";
    return disk + ".GetClass() {}\n" + ns + ":Disk.EnumerateKeyNames() {}\n" + disk + ".GetClass() {}\n";
}

TEST_P(RunCallsTest, OfRulesThatExcludeKeys)
{
    Disk(0, "sda", 100);
    Disk(1, "sdb", 200);
    Namespace(2);
    Rules("excludekeys=\"Id\"", "<includelist><value>Size</value></includelist>");
    const std::string validated = "ns0.GetClass(\"Disk\") {}\n"
                                  "ns0.GetClass(\"Disk\") {}\n"
                                  "ns0:Disk.GetPropertyDecl(\"Size\") {}\n"
                                  "ns0.GetClass(\"Disk\") {}\n"
                                  "ns0:Disk.EnumerateSubClasses(false) {}\n";
    EXPECT_EQ(SystemCheck({"ns0", "ns0", "ns1", "ns2"}) + validated + kWalk + "ns0:Disk.EnumerateInstances(false) {}\n" +
                  EmptyKey("ns0", "sda") +
                  "ns1.GetClass(\"Disk\") {}\n"
                  "ns1:Disk.EnumerateInstances(false) {}\n" +
                  EmptyKey("ns1", "sdb") +
                  "ns0:Disk.Id=\"sda\".GetProperty(\"Size\") {}\n"
                  "ns1:Disk.Id=\"sdb\".GetProperty(\"Size\") {}\n"
                  "ns0:Disk.Id=\"sda\".Size.GetValue() {}\n"
                  "ns1:Disk.Id=\"sdb\".Size.GetValue() {}\n" +
                  Alias("ns0", "sda", false) + Alias("ns1", "sdb", false) +
                  "ns2.GetClass(\"Disk\") {}\n"
                  "ns2:Disk.EnumerateInstances(false) {}\n" +
                  kClassRecord +
                  "ns0:Disk.Id=\"sda\".GetReference() {}\n"
                  "store.GetClass(\"Disk\") {nsIndex=0}\n" +
                  Record(1, "root/cimv2:Disk.Id=\"sda\"", "", "2", 1) + Record(4, "Disk", "Size", "1", 2) + kEndOfWalk,
              CallsOfRun());
    EXPECT_EQ("0:Disk Disk -> root/cimv2:Disk.Id=\"sda\"\n"
              "1:Disk Disk -> root/cimv2:Disk.Id=\"sdb\"\n",
              DumpAliases(fComparison.Delta()));
}

TEST_P(RunCallsTest, OfRulesThatExcludeKeysWithAnUnknownInstance)
{
    Namespace(0);
    Disk(1, "sda", 100);
    Namespace(2);
    Rules("excludekeys=\"Id\" default=\"include\"");
    EXPECT_EQ(SystemCheck({"ns0", "ns0", "ns1", "ns2"}) + kRulesRead + kWalk + kAllProperties +
                  "ns0:Disk.EnumerateInstances(false) {}\n"
                  "ns1.GetClass(\"Disk\") {}\n"
                  "ns1:Disk.EnumerateInstances(false) {}\n" +
                  EmptyKey("ns1", "sda") +
                  "ns1:Disk.Id=\"sda\".GetReference() {}\n"
                  "ns1:Disk.Id=\"sda\".GetClass() {}\n"
                  "ns1:Disk.GetName() {}\n"
                  "store.GetClass(\"Disk\") {nsIndex=1}\n"
                  "ns1.GetClass(\"Disk\") {nsIndex=1}\n"
                  "ns2.GetClass(\"Disk\") {}\n"
                  "ns2:Disk.EnumerateInstances(false) {}\n" +
                  kClassRecord + Record(2, "Disk", "", "1", 1) + kEndOfWalk,
              CallsOfRun());
}

TEST_P(RunCallsTest, OfAClassMissingInOneNamespace)
{
    Namespace(0);
    fComparison.Namespace(1);
    fComparison.Namespace(2).Class("Disk", "", {TNamespaceBuilder::Key("Id")}).Instance("Disk", {{"Id", "sda"}});
    Rules("default=\"include\"");
    EXPECT_EQ(SystemCheck({"ns0", "ns0", "ns1", "ns2"}) + kRulesRead + kWalk + kAllProperties +
                  "ns0:Disk.EnumerateInstances(false) {}\n"
                  "ns1.GetClass(\"Disk\") {}\n"
                  "ns2.GetClass(\"Disk\") {}\n"
                  "ns2:Disk.EnumerateInstances(false) {}\n" +
                  Key("ns2", "sda") + kClassRecord + Record(2, "Disk.Id=\"sda\"", "", "2", 1) + kEndOfWalk,
              CallsOfRun());
}

TEST_P(RunCallsTest, OfOneNamespace)
{
    Disk(0, "sda", 100);
    fComparison.Delta().SetSpecFileName("/nonexistent/rules.xml");
    EXPECT_EQ(std::string(kWalk) + kEndOfWalk, CallsOfRun());
}

TEST_P(RunCallsTest, OfAFileNameWithTheMarker)
{
    Disk(0, "sda", 100);
    Disk(1, "sda", 200);
    fComparison.Delta().SetSpecFileName("/nonexistent/rules.xml|fVMWareEnable");
    EXPECT_EQ(std::string(kWalk) + kEndOfWalk, CallsOfRun());
}

TEST_P(RunCallsTest, OfSubclassesDepthFirst)
{
    for (const std::size_t index : {0u, 1u}) {
        Namespace(index).Class("Ssd", "Disk", {}).Class("Nvme", "Ssd", {}).Class("Tape", "Disk", {});
    }
    fComparison.Delta().SetSpecFileName("|fVMWareEnable");
    EXPECT_EQ(std::string(kWalk) + kEndOfWalk +
                  "ns0:Ssd.GetName() {}\n"
                  "ns0:Ssd.EnumerateSubClasses(false) {}\n"
                  "ns0:Nvme.GetName() {}\n"
                  "ns0:Nvme.EnumerateSubClasses(false) {}\n"
                  "ns0:Tape.GetName() {}\n"
                  "ns0:Tape.EnumerateSubClasses(false) {}\n",
              CallsOfRun());
}

}  // namespace
}  // namespace NORVZEL20
