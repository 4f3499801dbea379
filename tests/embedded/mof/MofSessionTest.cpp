#include <gtest/gtest.h>

#include <string>

#include "embedded/cimxml/TCimXmlDocuments.h"
#include "embedded/mof/TMofDocuments.h"
#include "embedded/mof/TMofPopulator.h"
#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemNamespace.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {
namespace {

const std::string kKey = "Qualifier Key : boolean = false, Scope(any), Flavor(DisableOverride);\n"
                         "Qualifier Level : uint8, Scope(any);\nQualifier EmbeddedObject : boolean, Scope(any);\n";
const std::string kDisk =
    "[Level(5)] class Disk { [Key] string Id; uint8 Size = 7; Disk REF Next; [EmbeddedObject] string Inner; };\n";
const std::string kSda = "instance of Disk as $A { Id = \"sda\"; };\n";

std::string AsXml(const std::string& objects)
{
    return "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>" + objects + "</DECLGROUP></DECLARATION></CIM>";
}

const std::string kSdbXml =
    AsXml("<VALUE.OBJECT><INSTANCE CLASSNAME=\"Disk\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><VALUE>sdb</VALUE>"
          "</PROPERTY><PROPERTY NAME=\"Size\" TYPE=\"uint8\"><VALUE>9</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>");

/// One load of several documents of both forms.
class MofSessionTest : public testing::Test {
  protected:
    void Mof(const std::string& text) { fMof.ReadMemory(text.data(), text.size(), "doc" + std::to_string(++fNumber)); }
    void Xml(const std::string& text) { fXml.ReadMemory(text.data(), text.size(), "doc" + std::to_string(++fNumber)); }

    /// The instances of class Disk, in their order: key, size and what they hold.
    std::string Disks()
    {
        fSession.Commit();
        std::string text;
        const auto append = [&](const boost::shared_ptr<ICIMInstance>& instance) {
            for (const char* name : {"Id", "Size", "Next", "Inner"}) {
                text += instance->GetProperty(name, TCallContext())->GetValue(TCallContext()).ToText() + " ";
            }
            text += "\n";
            return true;
        };
        fNamespace->GetClass("Disk", TCallContext())->EnumerateInstances(append, false, TCallContext());
        return text;
    }
    std::string Error()
    {
        try {
            fSession.Commit();
            return std::string();
        } catch (const TPopulateError& error) {
            return error.what();
        }
    }

    boost::shared_ptr<TInMemNamespace> fNamespace = TInMemNamespace::Create("root/cimv2");
    TLoadSession fSession{fNamespace, "all"};
    TCimXmlDocuments fXml{fSession};
    TMofDocuments fMof{fSession};
    int fNumber = 0;
};

TEST_F(MofSessionTest, ASchemaInMofServesInstancesInCimXml)
{
    Mof(kKey + kDisk);
    Xml(kSdbXml);
    EXPECT_EQ("sdb 9 NULL NULL \n", Disks());
}

TEST_F(MofSessionTest, DocumentsMayComeInAnyOrder)
{
    Xml(kSdbXml);
    Mof(kSda);
    Mof(kDisk);
    Mof(kKey);
    EXPECT_EQ("sdb 9 NULL NULL \nsda 7 NULL NULL \n", Disks());
    const boost::shared_ptr<TInMemClass> disk = fNamespace->FindClass("Disk");
    EXPECT_EQ("uint8", TValueText::DescribeType(disk->GetQualifiers().Find("Level")->GetValue(TCallContext()).GetType()));
}

TEST_F(MofSessionTest, TextThatIsCimXmlIsAnEmbeddedObjectToo)
{
    Mof(kKey + kDisk + "instance of Disk { Id = \"sda\"; Inner = \"<INSTANCE CLASSNAME=\\\"Any\\\"/>\"; };");
    EXPECT_EQ("sda 7 NULL <INSTANCE CLASSNAME=\"Any\"></INSTANCE> \n", Disks());
    const auto instance = fNamespace->GetInstance(TCIMReference::Parse("Disk.Id=\"sda\""), TCallContext());
    EXPECT_TRUE(instance->GetProperty("Inner", TCallContext())->GetValue(TCallContext()).GetEmbeddedObject() != nullptr);
}

TEST_F(MofSessionTest, AliasesAreThoseOfTheirDocument)
{
    Mof(kKey + kDisk + kSda);
    Mof("instance of Disk as $A { Id = \"sdb\"; Next = $A; };");
    Mof("\ninstance of Disk { Id = \"sdc\"; Next = $A; };");
    EXPECT_EQ("doc3:2:32: found the alias $A, but no instance of the document has it; declare one \"as $A\"", Error());
}

TEST_F(MofSessionTest, TheSameAliasMayBeInSeveralDocuments)
{
    Mof(kKey + kDisk + kSda);
    Mof("instance of Disk as $A { Id = \"sdb\"; };\ninstance of Disk { Id = \"sdc\"; Next = $A; };");
    EXPECT_EQ("sda 7 NULL NULL \nsdb 7 NULL NULL \nsdc 7 Disk.Id=\"sdb\" NULL \n", Disks());
}

/// Neither what an instance refers to nor what it says is looked at.
TEST(MofPopulatorTest, ALoadOfDeclarationsLeavesInstancesOut)
{
    TLoadOptions options;
    options.takesDeclarationsOnly = true;
    for (const std::string& instances : {kSda, std::string("instance of Disk { Id = $None; Bogus = 1; };\ninstance of None { };"),
                                         kSda + kSda, std::string("instance of Disk { Size = 300; };")}) {
        const boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
        TLoadSession session(ns, "all", options);
        const std::string document = instances + kKey + kDisk;
        TMofDocuments(session).ReadMemory(document.data(), document.size(), "doc.mof");
        const TLoadReport report = session.Commit();
        EXPECT_EQ(1u, report.classes) << instances;
        EXPECT_EQ(0u, report.instances) << instances;
    }
}

TEST(MofPopulatorTest, KeptElementsAreClassesThenInstances)
{
    TMofPopulator populator(TInMemNamespace::Create("root/cimv2"));
    populator.KeepElements();
    const std::string document = kSda + kKey + kDisk + "class A { };";
    populator.LoadFromMemory(document.data(), document.size(), "doc.mof");
    EXPECT_EQ(3u, populator.TakeElements().size());
    EXPECT_EQ(0u, populator.TakeElements().size());
}

TEST(MofPopulatorTest, ASourceMayDeliverSmallPieces)
{
    const std::string document = kKey + kDisk;
    std::size_t at = 0;
    const auto source = [&](char* buffer, std::size_t) {
        if (at == document.size()) {
            return std::size_t{0};
        }
        *buffer = document[at++];
        return std::size_t{1};
    };
    EXPECT_EQ(1u, TMofPopulator(TInMemNamespace::Create("root/cimv2")).LoadFromSource(source, "doc.mof").classes);
}

}  // namespace
}  // namespace NORVZEL20
