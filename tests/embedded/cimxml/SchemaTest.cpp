#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <map>
#include <memory>
#include <set>
#include <string>

#include "embedded/cimxml/IXmlSink.h"
#include "embedded/cimxml/TXmlReader.h"
#include "embedded/store/TInMemClass.h"
#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

/// The text of a file that xz has compressed; fails the test if there is none.
std::string Decompress(const std::string& path)
{
    const auto close = [](std::FILE* pipe) { EXPECT_EQ(0, pclose(pipe)); };
    const std::unique_ptr<std::FILE, decltype(close)> pipe(popen(("xz -dc '" + path + "'").c_str(), "r"), close);
    std::string text;
    char piece[65536];
    for (std::size_t length = 1; pipe && (length = std::fread(piece, 1, sizeof piece, pipe.get())) > 0;) {
        text.append(piece, length);
    }
    EXPECT_FALSE(text.empty()) << path;
    return text;
}

/// The keys of each class and the classes of its references, "Of (Disk)", as a document states them that writes inherited elements
/// into each class.
class TStated : public IXmlSink {
  public:
    using TNames = std::map<std::string, std::set<std::string>>;

    void OnStart(const char* name, const char** attributes) override
    {
        const std::string element = name;
        if (element == "CLASS") {
            fClass = Find(attributes, "NAME");
            fNames[fClass];
        } else if (element == "METHOD") {
            fProperty.clear();
        } else if (element.compare(0, 8, "PROPERTY") == 0) {
            fProperty = Find(attributes, "NAME");
            if (const char* reference = Find(attributes, "REFERENCECLASS")) {
                fNames[fClass].insert(fProperty + " (" + reference + ")");
            }
        } else if (element == "QUALIFIER" && !fProperty.empty() && std::strcmp(Find(attributes, "NAME"), "Key") == 0) {
            fNames[fClass].insert(fProperty);
        }
    }
    void OnEnd(const char*) override {}
    void OnText(const char*, std::size_t) override {}

    TNames fNames;

  private:
    static const char* Find(const char** attributes, const char* name)
    {
        for (; *attributes != nullptr; attributes += 2) {
            if (std::strcmp(*attributes, name) == 0) {
                return attributes[1];
            }
        }
        return nullptr;
    }

    std::string fClass;
    std::string fProperty;
};

/// The same of the classes that are declared.
TStated::TNames DeclaredIn(const TInMemNamespace& ns)
{
    TStated::TNames names;
    for (const boost::shared_ptr<TInMemClass>& cls : ns.GetClasses()) {
        std::set<std::string>& there = names[cls->GetName()];
        for (const std::uint32_t slot : cls->GetLayout().GetOrder()) {
            const TInMemPropertyDecl& decl = cls->GetLayout().GetDecl(slot);
            if (decl.IsKey()) {
                there.insert(decl.GetName());
            }
            if (!decl.GetReferenceClass().empty()) {
                there.insert(decl.GetName() + " (" + decl.GetReferenceClass() + ")");
            }
        }
    }
    return names;
}

/// The published schema is not part of this project: the environment says where it is.
class SchemaTest : public testing::Test {
  protected:
    void SetUp() override
    {
        const char* folder = std::getenv("CIMDELTA_SCHEMA_DIR");
        if (folder == nullptr) {
            GTEST_SKIP()
                << "NOT CHECKED: the DMTF's schema may not be copied into this project; name its folder in CIMDELTA_SCHEMA_DIR";
        }
        fFolder = folder;
    }

    std::string fFolder;
    TLoading fLoading;
};

TEST_F(SchemaTest, ThePublishedQualifiersLoadAndComeBackEqual)
{
    const TLoadReport report = fLoading.LoadFile(fFolder + "/cim-2.49.0-qualifiers.xml");
    EXPECT_EQ(70u, report.qualifierDecls);
    TLoading again;
    again.Load(fLoading.Write());
    EXPECT_EQ(fLoading.Write(), again.Write());
}

/// The compiler that wrote this document marks every element that a superclass declares, also if the class overrides it.
TEST_F(SchemaTest, EachClassOfTheWholeSchemaHasTheKeysAndReferencesThatItsDeclarationStates)
{
    const std::string document = Decompress(fFolder + "/cim-2.49.0-declarations-pywbem.xml.xz");
    EXPECT_EQ(1631u, fLoading.Load(document).classes);
    TStated stated;
    ASSERT_TRUE(TXmlReader(stated).Parse(document.data(), document.size(), true));
    const TStated::TNames declared = DeclaredIn(*fLoading.GetNamespace());
    std::size_t differing = 0;
    for (const auto& [name, names] : stated.fNames) {
        const auto there = declared.find(name);
        differing += there == declared.end() || there->second != names ? 1 : 0;
    }
    EXPECT_EQ(1631u, stated.fNames.size());
    EXPECT_EQ(0u, differing);
}

TEST_F(SchemaTest, TheWholeSchemaIsWrittenWithoutWhatClassesInheritAndComesBackEqual)
{
    fLoading.Load(Decompress(fFolder + "/cim-2.49.0-declarations-pywbem.xml.xz"));
    const std::string written = fLoading.Write();
    TLoading again;
    again.Load(written);
    EXPECT_TRUE(written == again.Write());
    EXPECT_EQ(DeclaredIn(*fLoading.GetNamespace()), DeclaredIn(*again.GetNamespace()));
}

}  // namespace
}  // namespace NORVZEL20
