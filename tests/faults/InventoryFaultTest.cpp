// Loading an inventory when memory runs out, when the source throws and when the file has faults. A load is all or nothing, so the
// text of the whole namespace is compared before and after; then the same load must succeed.

#include <gtest/gtest.h>

#include <cerrno>
#include <cstring>
#include <fstream>
#include <iostream>
#include <stdexcept>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "host/TNamespacePopulator.h"
#include "tests/faults/FailEachAllocation.h"
#include "tests/faults/TFaultyStream.h"
#include "tests/faults/TOpenHook.h"
#include "tests/support/Dump.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TComparisonRun.h"

namespace NORVZEL20 {
namespace {

using EMode = TFailingAllocator::EMode;

const std::string kHead =
    "<?xml version='1.0' encoding='utf-8'?>\n<CIM CIMVERSION='2.0' DTDVERSION='2.0'><DECLARATION><DECLGROUP>\n";
const std::string kFoot = "</DECLGROUP></DECLARATION></CIM>\n";
const std::string kKey = "<QUALIFIER NAME='Key' TYPE='boolean'><VALUE>true</VALUE></QUALIFIER>";

/// The contents before the load: a class and an instance.
const std::string kBase =
    kHead +
    "<QUALIFIER.DECLARATION NAME='Key' TYPE='boolean'><SCOPE PROPERTY='true' REFERENCE='true'/></QUALIFIER.DECLARATION>\n"
    "<VALUE.OBJECT><CLASS NAME='Device'><PROPERTY NAME='Id' TYPE='string'>" +
    kKey +
    "</PROPERTY><PROPERTY NAME='Remark' TYPE='string'/></CLASS></VALUE.OBJECT>\n"
    "<VALUE.OBJECT><INSTANCE CLASSNAME='Device'><PROPERTY NAME='Id' TYPE='string'><VALUE>first</VALUE></PROPERTY>"
    "</INSTANCE></VALUE.OBJECT>\n" +
    kFoot;

/// The inventory: subclasses before their superclass, methods, references, arrays, embedded objects, instances of old and new
/// classes.
const std::string kMore =
    kHead +
    "<QUALIFIER.DECLARATION NAME='Description' TYPE='string'><SCOPE CLASS='true'/></QUALIFIER.DECLARATION>\n"
    "<VALUE.OBJECT><CLASS NAME='Ssd' SUPERCLASS='Disk'><QUALIFIER NAME='Description' TYPE='string'><VALUE>solid &amp; fast"
    "</VALUE></QUALIFIER><PROPERTY NAME='Wear' TYPE='uint8'/></CLASS></VALUE.OBJECT>\n"
    "<VALUE.OBJECT><CLASS NAME='Disk' SUPERCLASS='Device'><PROPERTY NAME='Size' TYPE='uint64'/>"
    "<PROPERTY.ARRAY NAME='Labels' TYPE='string'/><PROPERTY.REFERENCE NAME='Mirror' REFERENCECLASS='Disk'/>"
    "<PROPERTY NAME='Detail' TYPE='string'/><METHOD NAME='Format' TYPE='uint32'><PARAMETER NAME='Quick' TYPE='boolean'/></METHOD>"
    "</CLASS></VALUE.OBJECT>\n"
    "<VALUE.OBJECT><INSTANCE CLASSNAME='Disk'><PROPERTY NAME='Id' TYPE='string'><VALUE>a disk with a long identifier</VALUE>"
    "</PROPERTY><PROPERTY NAME='Size' TYPE='uint64'><VALUE>18446744073709551615</VALUE></PROPERTY>"
    "<PROPERTY.ARRAY NAME='Labels' TYPE='string'><VALUE.ARRAY><VALUE>one label</VALUE><VALUE.NULL/><VALUE>another, longer label"
    "</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>"
    "<PROPERTY.REFERENCE NAME='Mirror'><VALUE.REFERENCE><INSTANCENAME CLASSNAME='Ssd'><KEYBINDING NAME='Id'>"
    "<KEYVALUE VALUETYPE='string'>the other one</KEYVALUE></KEYBINDING></INSTANCENAME></VALUE.REFERENCE></PROPERTY.REFERENCE>"
    "<PROPERTY NAME='Detail' TYPE='string' EmbeddedObject='instance'><VALUE>&lt;INSTANCE CLASSNAME=\"Part\"&gt;"
    "&lt;PROPERTY NAME=\"Number\" "
    "TYPE=\"uint8\"&gt;&lt;VALUE&gt;7&lt;/VALUE&gt;&lt;/PROPERTY&gt;&lt;/INSTANCE&gt;</VALUE></PROPERTY>"
    "</INSTANCE></VALUE.OBJECT>\n"
    "<VALUE.OBJECT><INSTANCE CLASSNAME='Ssd'><PROPERTY NAME='Id' TYPE='string'><VALUE>the other one</VALUE></PROPERTY>"
    "<PROPERTY NAME='Wear' TYPE='uint8'><VALUE>3</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>\n"
    "<VALUE.OBJECT><INSTANCE CLASSNAME='Device'><PROPERTY NAME='Id' TYPE='string'><VALUE>second</VALUE></PROPERTY>"
    "<PROPERTY NAME='Remark' TYPE='string'><VALUE>a remark that is kept on the "
    "heap</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>\n" +
    kFoot;

/// Everything in the namespace, as text.
std::string DumpNamespace(boost::shared_ptr<ICIMNamespace> ns)
{
    const TCallContext none;
    std::string text;
    ns->EnumerateQualifierDecls(
        [&](boost::shared_ptr<ICIMQualifierDecl> decl) {
            text += "qualifier " + decl->GetName(none) + "\n";
            return true;
        },
        none);
    const auto append = [&](boost::shared_ptr<ICIMClass> cls) {
        text += "class " + cls->GetName(none) + "\n" + DumpInstances(ns, cls->GetName(none));
        return true;
    };
    ns->GetClass("<root>", none)->EnumerateSubClasses(append, true, none);
    return text;
}

boost::shared_ptr<ICIMNamespace> MakeBase()
{
    const auto ns = MakeNamespace(EHost::kInmem, "root/cimv2");
    TCimXmlPopulator(ns).LoadFromMemory(kBase.data(), kBase.size(), "base.xml");
    return ns;
}

std::string DumpWithMore()
{
    const auto ns = MakeBase();
    TCimXmlPopulator(ns).LoadFromMemory(kMore.data(), kMore.size(), "more.xml");
    return DumpNamespace(ns);
}

/// Delivers a text in pieces of one length.
class TPieces {
  public:
    TPieces(const std::string& text, std::size_t length) : fText(text), fLength(length) {}

    std::size_t operator()(char* buffer, std::size_t size)
    {
        const std::size_t length = std::min({size, fLength, fText.size() - fPosition});
        std::memcpy(buffer, fText.data() + fPosition, length);
        fPosition += length;
        return length;
    }

  private:
    const std::string& fText;
    std::size_t fLength;
    std::size_t fPosition = 0;
};

/// Loads into a namespace that is not empty.
class TLoadMore : public IFaultyAction {
  public:
    using TLoad = std::function<void(boost::shared_ptr<ICIMNamespace>)>;

    TLoadMore(TLoad load, const std::string& before, const std::string& after) : fLoad(load), fBefore(before), fAfter(after) {}

    void Act() override { fLoad(fNamespace); }

    void Verify(const std::string& outcome) override
    {
        EXPECT_EQ(outcome.empty() ? fAfter : fBefore, DumpNamespace(fNamespace));
        if (!outcome.empty()) {
            fLoad(fNamespace);
            EXPECT_EQ(fAfter, DumpNamespace(fNamespace));
        }
    }

  private:
    TLoad fLoad;
    const std::string& fBefore;
    const std::string& fAfter;
    boost::shared_ptr<ICIMNamespace> fNamespace = MakeBase();
};

class TInventoryOutOfMemoryFixture : public testing::TestWithParam<EMode> {
  protected:
    std::string FailEach(const std::string& series, TLoadMore::TLoad load)
    {
        const std::string before = DumpNamespace(MakeBase());
        const std::string after = DumpWithMore();
        const auto make = [&] { return std::make_unique<TLoadMore>(load, before, after); };
        return FailEachAllocation(series + (GetParam() == EMode::kOnce ? "Once" : "FromThenOn"), make, GetParam());
    }
};
using InventoryOutOfMemory = TInventoryOutOfMemoryFixture;

TEST_P(InventoryOutOfMemory, LoadingFromMemoryLeavesTheNamespaceAsItWas)
{
    EXPECT_EQ("bad_alloc", FailEach("LoadFromMemory", [](boost::shared_ptr<ICIMNamespace> ns) {
                  TCimXmlPopulator(ns).LoadFromMemory(kMore.data(), kMore.size(), "more.xml");
              }));
}

TEST_P(InventoryOutOfMemory, LoadingInPiecesLeavesTheNamespaceAsItWas)
{
    EXPECT_EQ("bad_alloc", FailEach("LoadFromSource", [](boost::shared_ptr<ICIMNamespace> ns) {
                  TCimXmlPopulator(ns).LoadFromSource(TPieces(kMore, 100), "more.xml");
              }));
}

TEST_P(InventoryOutOfMemory, PopulatingFromAFileLeavesTheNamespaceAsItWas)
{
    const TScratchFile file(kMore);
    EXPECT_EQ("bad_alloc", FailEach("PopulateFromXMLFile", [&](boost::shared_ptr<ICIMNamespace> ns) {
                  TNamespacePopulator::PopulateFromXMLFile(ns, file.GetPath());
              }));
}

INSTANTIATE_TEST_SUITE_P(Faults, InventoryOutOfMemory, testing::Values(EMode::kOnce, EMode::kFromThenOn),
                         [](const auto& test) { return test.param == EMode::kOnce ? "Once" : "FromThenOn"; });

/// An inventory from a file with faults.
class TInventorySourceFixture : public testing::Test {
  protected:
    /// Loads the file. Returns "", or for example `status 11` with the error's text in fMessage.
    std::string LoadFile()
    {
        fMessage.clear();
        return OutcomeOf([this] {
            try {
                TCimXmlPopulator(fNamespace).LoadFile(fFile.GetPath());
            } catch (const TPopulateError& error) {
                fMessage = error.what();
                throw;
            }
        });
    }

    std::string LoadThrough(TFaultyStream& stream)
    {
        const TOpenHook hook(fFile.GetPath(), [&stream](const char*) { return stream.Open(); });
        return LoadFile();
    }

    std::string LoadFrom(const TCimXmlPopulator::TPullSource& source)
    {
        return OutcomeOf([&] { TCimXmlPopulator(fNamespace).LoadFromSource(source, "more.xml"); });
    }

    void ExpectAsBefore() const { EXPECT_EQ(kBefore, DumpNamespace(fNamespace)); }

    const std::string kBefore = DumpNamespace(MakeBase());
    const std::string kAfter = DumpWithMore();
    TScratchFile fFile{kMore};
    boost::shared_ptr<ICIMNamespace> fNamespace = MakeBase();
    std::string fMessage;
};
using InventorySource = TInventorySourceFixture;

TEST_F(InventorySource, IsReadInWhateverPieces)
{
    for (const std::size_t length : {1u, 2u, 3u, 7u, 100u, 4096u}) {
        fNamespace = MakeBase();
        TFaultyStream stream(kMore, length);
        EXPECT_EQ("", LoadThrough(stream)) << fMessage;
        EXPECT_EQ(kAfter, DumpNamespace(fNamespace));
        EXPECT_FALSE(stream.IsOpen());
    }
}

TEST_F(InventorySource, ErrorAnywhereIsAFileErrorAndTheFileIsClosed)
{
    for (std::size_t offset = 0; offset <= kMore.size(); offset += 7) {
        TFaultyStream stream(kMore, 64, offset);
        EXPECT_EQ("status 11", LoadThrough(stream)) << offset;
        EXPECT_EQ(fFile.GetPath() + ": cannot read the file: Input/output error", fMessage);
        EXPECT_FALSE(stream.IsOpen());
        ExpectAsBefore();
    }
    std::cout << "inventory: " << kMore.size() / 7 + 1 << " read errors\n";
    RecordProperty("InventoryReadErrors", std::to_string(kMore.size() / 7 + 1));
}

TEST_F(InventorySource, ErrorThatPassesIsStillAnError)
{
    TFaultyStream stream(kMore, 64, 640, 1);
    EXPECT_EQ("status 11", LoadThrough(stream));
    ExpectAsBefore();
}

TEST_F(InventorySource, ThatCannotBeOpenedIsAFileError)
{
    const TOpenHook hook(fFile.GetPath(), [](const char*) -> std::FILE* {
        errno = EMFILE;
        return nullptr;
    });
    EXPECT_EQ("status 11", LoadFile());
    EXPECT_EQ(fFile.GetPath() + ": cannot open the file: Too many open files", fMessage);
    ExpectAsBefore();
}

TEST_F(InventorySource, ThatEndsTooEarlyIsAParseError)
{
    const std::size_t end = kMore.rfind('>');
    for (std::size_t length = 0; length <= end; length += 5) {
        const std::string part = kMore.substr(0, length);
        EXPECT_EQ("status 9", LoadFrom(TPieces(part, 50))) << length;
        ExpectAsBefore();
    }
    RecordProperty("InventoryShrunk", std::to_string(end / 5 + 1));
}

TEST_F(InventorySource, ThatGrowsWhileItIsReadIsReadToItsEnd)
{
    const std::size_t half = kMore.size() / 2;
    std::ofstream(fFile.GetPath(), std::ios::binary) << kMore.substr(0, half);
    const TOpenHook hook(fFile.GetPath(), [&](const char* mode) {
        std::FILE* const file = TOpenHook::OpenReally(fFile.GetPath().c_str(), mode);
        std::ofstream(fFile.GetPath(), std::ios::binary | std::ios::app) << kMore.substr(half);
        return file;
    });
    EXPECT_EQ("", LoadFile());
    EXPECT_EQ(kAfter, DumpNamespace(fNamespace));
}

TEST_F(InventorySource, ThatShrinksWhileItIsReadIsAParseError)
{
    const TOpenHook hook(fFile.GetPath(), [&](const char* mode) {
        std::FILE* const file = TOpenHook::OpenReally(fFile.GetPath().c_str(), mode);
        std::ofstream(fFile.GetPath(), std::ios::binary) << kMore.substr(0, kMore.size() / 2);
        return file;
    });
    EXPECT_EQ("status 9", LoadFile());
    ExpectAsBefore();
}

TEST_F(InventorySource, ExceptionOfTheSourceComesOutAsItWas)
{
    for (std::size_t piece = 1; piece <= kMore.size() / 100; ++piece) {
        std::size_t count = 0;
        TPieces pieces(kMore, 100);
        const auto source = [&](char* buffer, std::size_t size) {
            return ++count == piece ? throw std::out_of_range("the source's own") : pieces(buffer, size);
        };
        EXPECT_THROW(TCimXmlPopulator(fNamespace).LoadFromSource(source, "more.xml"), std::out_of_range) << piece;
        ExpectAsBefore();
    }
    EXPECT_EQ("", LoadFrom(TPieces(kMore, 100)));
    EXPECT_EQ(kAfter, DumpNamespace(fNamespace));
}

}  // namespace
}  // namespace NORVZEL20
