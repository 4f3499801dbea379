#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <cstdlib>
#include <filesystem>
#include <string>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/mof/TMofFolders.h"
#include "embedded/mof/TMofPopulator.h"
#include "tests/embedded/mof/DescribeDeclarations.h"

namespace NORVZEL20 {
namespace {

const std::string kMofDocuments = CIMDELTA_TEST_DATA "/interchange-pywbem/";

TEST(MofSchemaTest, TheCorpusDeclaresWhatItsXmlDeclares)
{
    const auto mof = TInMemNamespace::Create("root/cimv2");
    TMofPopulator(mof).LoadFile(kMofDocuments + "corpus.mof");
    const auto xml = TInMemNamespace::Create("root/cimv2");
    TCimXmlPopulator(xml).LoadFile(kMofDocuments + "01-qualifiers.xml");
    TCimXmlPopulator(xml).LoadFile(kMofDocuments + "02-classes.xml");
    // The flavor TOINSTANCE, which MOF 2.x has no word for.
    EXPECT_EQ("+ class TST_AllTypes [tst_weights] real64[] '{0.5, -1.25e+300}' flavor 3\n"
              "- class TST_AllTypes [tst_weights] real64[] '{0.5, -1.25e+300}' flavor 7\n"
              "+ class TST_Base [tst_weights] real64[] '{0.5, -1.25e+300}' flavor 3\n"
              "- class TST_Base [tst_weights] real64[] '{0.5, -1.25e+300}' flavor 7\n"
              "+ qualifier TST_Weights real64[] NULL scope 1 flavor 3\n"
              "- qualifier TST_Weights real64[] NULL scope 1 flavor 7\n",
              DiffDeclarations(*xml, *mof));
}

/// The published schema, unpacked. It is not part of this project: the environment says where it is.
class TPublishedSchema {
  public:
    explicit TPublishedSchema(const std::string& folder) : fPath(testing::TempDir() + "cimdelta-mof-XXXXXX")
    {
        EXPECT_NE(nullptr, mkdtemp(fPath.data()));
        EXPECT_EQ(0, std::system(("unzip -q -d '" + fPath + "' '" + folder + "/cim_schema_2.49.0Final-MOFs.zip'").c_str()));
        EXPECT_EQ(0, std::system(("xz -dc '" + folder + "/cim-2.49.0-declarations-pywbem.xml.xz' > '" + Xml() + "'").c_str()));
    }
    TPublishedSchema(const TPublishedSchema&) = delete;
    TPublishedSchema& operator=(const TPublishedSchema&) = delete;
    ~TPublishedSchema() { std::filesystem::remove_all(fPath); }

    const std::string& Folder() const { return fPath; }
    std::string Mof() const { return fPath + "/cim_schema_2.49.0.mof"; }
    std::string Xml() const { return fPath + "/schema.xml"; }

  private:
    std::string fPath;
};

TEST(MofSchemaTest, ThePublishedSchemaDeclaresWhatItsXmlDeclares)
{
    const char* folder = std::getenv("CIMDELTA_SCHEMA_DIR");
    if (folder == nullptr) {
        GTEST_SKIP()
            << "NOT CHECKED: the DMTF's schema may not be copied into this project; name its folder in CIMDELTA_SCHEMA_DIR";
    }
    const TPublishedSchema schema(folder);
    const auto includes = boost::make_shared<TMofFolders>();
    includes->Add(schema.Folder());
    const auto mof = TInMemNamespace::Create("root/cimv2");
    const TLoadReport report = TMofPopulator(mof, includes).LoadFile(schema.Mof());
    EXPECT_EQ(1631u, report.classes);
    EXPECT_EQ(70u, report.qualifierDecls);
    EXPECT_TRUE(report.tolerated.empty());
    const auto xml = TInMemNamespace::Create("root/cimv2");
    TCimXmlPopulator(xml).LoadFile(schema.Xml());
    // The other writer drops each \' of a text. Carriage returns it writes as they are, and readers of XML make line feeds of them.
    EXPECT_EQ("", DiffDeclarations(*xml, *mof, "'\r\n"));
}

}  // namespace
}  // namespace NORVZEL20
