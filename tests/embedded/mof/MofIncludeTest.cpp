#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <filesystem>
#include <fstream>
#include <string>
#include <utility>
#include <vector>

#include "embedded/load/TLoadSession.h"
#include "embedded/mof/TMofDocuments.h"
#include "embedded/mof/TMofFolders.h"
#include "embedded/mof/TMofPopulator.h"
#include "tests/embedded/mof/TMofLoading.h"

namespace NORVZEL20 {
namespace {

std::string Include(const std::string& name)
{
    return "#pragma include (\"" + name + "\")\n";
}

TEST(MofIncludeTest, AFileIsReadInItsPlaceAndOnce)
{
    TMofLoading loading;
    loading.File("quals.mof", "Qualifier Key : boolean = false, Scope(any), Flavor(DisableOverride);")
        .File("disk.mof", Include("quals.mof") + "class Disk { [Key] string Id; };");
    const TLoadReport report =
        loading.Load(Include("disk.mof") + Include("quals.mof") + Include("disk.mof") + "instance of Disk { Id = \"a\"; };");
    EXPECT_EQ(1u, report.qualifierDecls);
    EXPECT_EQ(1u, report.classes);
    EXPECT_EQ(1u, report.instances);
    EXPECT_EQ("", TMofLoading::Tolerated(report));
}

TEST(MofIncludeTest, AliasesAreKnownInAllFilesOfADocument)
{
    TMofLoading loading;
    loading.File("disk.mof", "instance of Disk as $A { Id = \"a\"; };");
    loading.Load("class Disk { [Key] string Id; Disk REF Next; };\ninstance of Disk { Id = \"b\"; Next = $A; };" +
                 Include("disk.mof"));
    EXPECT_EQ("Disk.Id=\"a\"", loading.ValueOf("Disk.Id=\"b\"", "Next"));
}

TEST(MofIncludeTest, MistakesAreReportedInTheFileThatHasThem)
{
    TMofLoading loading;
    loading.File("bad.mof", "\n oops").File("late.mof", "\nclass B : Missing { };").File("good.mof", "class C { };");
    EXPECT_EQ("bad.mof:2:2: found \"oops\", expected a class, an instance, a qualifier or #pragma",
              loading.ErrorOf("class A { };" + Include("bad.mof")));
    EXPECT_EQ("late.mof:2:1: found class \"B\" with the superclass \"Missing\", which is not declared; give its declaration",
              loading.ErrorOf(Include("late.mof") + "class A { };"));
    EXPECT_EQ("doc.mof:2:1: found \"oops\", expected a class, an instance, a qualifier or #pragma",
              loading.ErrorOf(Include("good.mof") + "oops"));
    EXPECT_EQ("late.mof:2:1: found class \"B\" with the superclass \"Missing\", which is not declared; give its declaration",
              loading.File("late.mof", "\nclass B : Missing { [Undeclared] string Id; };").ErrorOf(Include("late.mof")));
}

TEST(MofIncludeTest, ACircleIsAnError)
{
    TMofLoading loading;
    loading.File("a.mof", Include("b.mof")).File("b.mof", "\n" + Include("a.mof")).File("self.mof", Include("self.mof"));
    EXPECT_EQ("b.mof:2:25: found an include of \"a.mof\", which includes this document; remove one of the two",
              loading.ErrorOf(Include("a.mof")));
    EXPECT_EQ("self.mof:1:28: found an include of \"self.mof\", which includes this document; remove one of the two",
              loading.ErrorOf(Include("self.mof")));
}

TEST(MofIncludeTest, ACompressedFileIsRefused)
{
    for (const std::string& bytes : {std::string("\x1f\x8b\x08\0\0", 5), std::string("\xfd\x37zXZ\0", 6),
                                     std::string("\x28\xb5\x2f\xfd\x04\0", 6), std::string("BZh91AY")}) {
        TMofLoading loading;
        loading.File("base.mof", bytes);
        EXPECT_EQ(
            "doc.mof:1:28: found an include of \"base.mof\", which is compressed; included files must be plain, so decompress it",
            loading.ErrorOf(Include("base.mof")));
    }
}

TEST(MofIncludeTest, IncludesAreBounded)
{
    TMofLoading loading;
    for (int number = 0; number < 40; ++number) {
        loading.File(std::to_string(number), Include(std::to_string(number + 1)));
    }
    loading.File("40", "class A { };");
    EXPECT_EQ("", loading.ErrorOf(Include("9")));
    EXPECT_EQ("32:1:22: found an include of \"33\", which is one too many or too deep; join some of the files",
              loading.ErrorOf(Include("0")));
}

/// One load of several documents that may include files.
class MofSharedIncludeTest : public testing::Test {
  protected:
    MofSharedIncludeTest()
    {
        File("base.mof", "Qualifier Key : boolean = false, Scope(any), Flavor(DisableOverride);\n"
                         "class Disk { [Key] string Id; Disk REF Next; };\ninstance of Disk as $A { Id = \"a\"; };\n");
    }

    void File(const std::string& name, const std::string& text) { fFiles->fTexts[name] = text; }

    /// Loads the documents, "NAME" those that others may include. Returns the message if that fails, or what was tolerated.
    std::string Load(const std::vector<std::pair<std::string, std::string>>& documents)
    {
        try {
            fNamespace = TInMemNamespace::Create("root/cimv2");
            TLoadSession session(fNamespace, "all");
            TMofDocuments mof(session, fFiles);
            for (const auto& [name, text] : documents) {
                mof.ReadMemory(text.data(), text.size(), name);
            }
            fReport = session.Commit();
            return TMofLoading::Tolerated(fReport);
        } catch (const TPopulateError& error) {
            return error.what();
        }
    }
    std::string NextOf(const std::string& id) const
    {
        return fNamespace->GetInstance(TCIMReference::Parse("Disk.Id=\"" + id + "\""), TCallContext())
            ->GetProperty("Next", TCallContext())
            ->GetValue(TCallContext())
            .ToText();
    }

    boost::shared_ptr<TMofFiles> fFiles = boost::make_shared<TMofFiles>();
    boost::shared_ptr<TInMemNamespace> fNamespace;
    TLoadReport fReport;
};

const std::string kB = "instance of Disk { Id = \"b\"; Next = $A; };";
const std::string kC = "instance of Disk { Id = \"c\"; Next = $A; };";

TEST_F(MofSharedIncludeTest, AFileThatTwoDocumentsIncludeIsReadOnce)
{
    EXPECT_EQ("", Load({{"1", Include("base.mof") + kB}, {"2", Include("base.mof") + kC}}));
    EXPECT_EQ(3u, fReport.instances);
    EXPECT_EQ("Disk.Id=\"a\"", NextOf("b"));
    EXPECT_EQ("Disk.Id=\"a\"", NextOf("c"));
}

TEST_F(MofSharedIncludeTest, ADocumentThatAnotherOneIncludesIsReadOnceInAnyOrder)
{
    const std::pair<std::string, std::string> base{"base.mof", fFiles->fTexts["base.mof"]};
    const std::pair<std::string, std::string> other{"1", Include("base.mof") + kB};
    for (const auto& documents : {std::vector{base, other}, std::vector{other, base}}) {
        EXPECT_EQ("", Load(documents));
        EXPECT_EQ(2u, fReport.instances);
        EXPECT_EQ("Disk.Id=\"a\"", NextOf("b"));
    }
}

/// The second document includes what includes the file, and all of that was read for the first one.
TEST_F(MofSharedIncludeTest, AliasesAreKnownThroughOtherFiles)
{
    File("through.mof", Include("base.mof"));
    EXPECT_EQ("", Load({{"1", Include("base.mof") + Include("through.mof") + kB}, {"2", Include("through.mof") + kC}}));
    EXPECT_EQ("Disk.Id=\"a\"", NextOf("c"));
    EXPECT_EQ("", Load({{"1", Include("base.mof")}, {"2", Include("through.mof")}, {"3", Include("through.mof") + kC}}));
    EXPECT_EQ("Disk.Id=\"a\"", NextOf("c"));
}

TEST_F(MofSharedIncludeTest, TheAliasesOfAnotherDocumentAreNot)
{
    const std::string own = "instance of Disk as $Own { Id = \"o\"; };";
    EXPECT_EQ(
        "2:2:30: found the alias $Own, but no instance of the document has it; declare one \"as $Own\"",
        Load({{"1", Include("base.mof") + own}, {"2", Include("base.mof") + "instance of Disk { Id = \"c\"; Next = $Own; };"}}));
    EXPECT_EQ("base.mof:3:1: found the alias $A a second time, after 2:2; name one of the two otherwise",
              Load({{"1", Include("base.mof")}, {"2", Include("base.mof") + "instance of Disk as $A { Id = \"c\"; };"}}));
}

TEST_F(MofSharedIncludeTest, ADocumentThatIncludesItselfIsACircle)
{
    File("self.mof", Include("through.mof"));
    File("through.mof", Include("self.mof"));
    EXPECT_EQ("through.mof:1:28: found an include of \"self.mof\", which includes this document; remove one of the two",
              Load({{"self.mof", fFiles->fTexts["self.mof"]}}));
}

/// Folders and files on disk, removed with this object:
///
///     given/main.mof  given/sub/part.mof  given/link.mof -> sub/part.mof  given/out.mof -> ../secret.mof  given/away -> ..
///     second/more.mof  secret.mof
class MofFoldersTest : public testing::Test {
  protected:
    MofFoldersTest() : fRoot(testing::TempDir() + "cimdelta-folders-XXXXXX"), fFolders(boost::make_shared<TMofFolders>())
    {
        EXPECT_NE(nullptr, mkdtemp(fRoot.data()));
        fRoot += '/';
        for (const char* folder : {"given/sub", "second"}) {
            std::filesystem::create_directories(fRoot + folder);
        }
        Write("given/sub/part.mof", "class Part { };");
        Write("second/more.mof", "class More { };");
        Write("secret.mof", "class Secret { };");
        std::filesystem::create_symlink("sub/part.mof", fRoot + "given/link.mof");
        std::filesystem::create_symlink("../secret.mof", fRoot + "given/out.mof");
        std::filesystem::create_symlink("..", fRoot + "given/away");
        fFolders->Add(fRoot + "given");
        fFolders->Add(fRoot + "second/");
        fFolders->Add(fRoot + "missing");
    }
    ~MofFoldersTest() override { std::filesystem::remove_all(fRoot); }

    void Write(const std::string& name, const std::string& text) const { std::ofstream(fRoot + name) << text; }

    /// Loads given/main.mof, which includes the name: "" or the message without the folder.
    std::string ErrorOfInclude(const std::string& name)
    {
        Write("given/main.mof", Include(name));
        try {
            TMofPopulator(TInMemNamespace::Create("root/cimv2"), fFolders).LoadFile(fRoot + "given/main.mof");
            return std::string();
        } catch (const TPopulateError& error) {
            return error.GetMessage();
        }
    }

    std::string fRoot;
    boost::shared_ptr<TMofFolders> fFolders;
};

TEST_F(MofFoldersTest, FilesOfTheGivenFoldersMayBeIncluded)
{
    for (const char* name : {"sub/part.mof", "sub\\\\part.mof", "./sub/../sub/part.mof", "more.mof", "link.mof"}) {
        EXPECT_EQ("", ErrorOfInclude(name)) << name;
    }
}

TEST_F(MofFoldersTest, NothingElseMayBeIncluded)
{
    const std::string outside = "which is outside of the folders given for included files; put it into one of them";
    const std::string nowhere = "which is not there; put it into one of the folders given for included files";
    const struct {
        std::string name;
        std::string reason;
    } kRows[] = {
        {"../secret.mof", outside},
        {"sub/../../secret.mof", outside},
        {"away/secret.mof", outside},
        {"out.mof", outside},
        {fRoot + "given/sub/part.mof", outside},
        {"/etc/hostname", outside},
        {"", outside},
        {"none.mof", nowhere},
        {"sub/none/../part.mof", nowhere},
        {"sub", "which is no file"},
    };
    for (const auto& row : kRows) {
        EXPECT_EQ("found an include of \"" + row.name + "\", " + row.reason, ErrorOfInclude(row.name));
    }
}

TEST_F(MofFoldersTest, AFolderIsAddedOnce)
{
    EXPECT_EQ(2u, fFolders->CountFolders());
    for (const char* name : {"given", "given/", "given/sub/..", "second/../given/away/given"}) {
        fFolders->Add(fRoot + name);
        EXPECT_EQ(2u, fFolders->CountFolders()) << name;
    }
    fFolders->Add(fRoot + "given/sub");
    EXPECT_EQ(3u, fFolders->CountFolders());
}

TEST_F(MofFoldersTest, AFileThatHasTooManyBytesIsRefused)
{
    IMofIncludes::TFile file;
    std::string reason;
    std::string bytes;
    ASSERT_TRUE(fFolders->Find("part.mof", fRoot + "given/sub/x.mof", file, reason));
    EXPECT_TRUE(fFolders->Read(file, 15, bytes, reason));
    EXPECT_EQ("class Part { };", bytes);
    EXPECT_FALSE(fFolders->Read(file, 14, bytes, reason));
    EXPECT_EQ("which has more than 14 bytes; split it", reason);
}

TEST_F(MofFoldersTest, ALinkThatReplacesAFileIsNotFollowed)
{
    IMofIncludes::TFile file;
    std::string reason;
    std::string bytes;
    ASSERT_TRUE(fFolders->Find("sub/part.mof", fRoot + "given/main.mof", file, reason));
    std::filesystem::remove(fRoot + "given/sub/part.mof");
    std::filesystem::create_symlink("../../secret.mof", fRoot + "given/sub/part.mof");
    EXPECT_FALSE(fFolders->Read(file, 1000, bytes, reason));
    EXPECT_EQ(0u, reason.find("which cannot be opened: ")) << reason;
}

TEST_F(MofFoldersTest, ADocumentIsTheFileOfItsName)
{
    fFolders->Add(fRoot + "given/./");
    Write("given/main.mof", Include("sub/part.mof"));
    Write("given/twice.mof", Include("link.mof") + "class Other { };");
    TLoadSession session(TInMemNamespace::Create("root/cimv2"), "all");
    TMofDocuments mof(session, fFolders);
    for (const char* name : {"given/main.mof", "given/sub/part.mof", "given/twice.mof", "given/link.mof", "secret.mof"}) {
        mof.ReadFile(fRoot + name);
    }
    const TLoadReport report = session.Commit();
    EXPECT_EQ(3u, report.classes);
    EXPECT_EQ("", TMofLoading::Tolerated(report));
}

TEST_F(MofFoldersTest, TheFileItselfIsReadFromAnyPlace)
{
    EXPECT_EQ(1u, TMofPopulator(TInMemNamespace::Create("root/cimv2")).LoadFile(fRoot + "secret.mof").classes);
    try {
        TMofPopulator(TInMemNamespace::Create("root/cimv2")).LoadFile(fRoot + "none.mof");
        FAIL();
    } catch (const TPopulateError& error) {
        EXPECT_EQ(fRoot + "none.mof: cannot open the file: No such file or directory", error.what());
        EXPECT_EQ(TZELStatusCode::kFileError, error.GetStatusCode().GetStatus());
    }
}

}  // namespace
}  // namespace NORVZEL20
