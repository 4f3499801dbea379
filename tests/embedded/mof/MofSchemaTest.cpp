#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <cstdlib>
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

/// The published schema is not part of this project: the environment says where it is.
TEST(MofSchemaTest, ThePublishedSchemaDeclaresWhatItsXmlDeclares)
{
    const char* folder = std::getenv("CIMDELTA_SCHEMA_DIR");
    if (folder == nullptr) {
        GTEST_SKIP() << "NOT CHECKED: the DMTF's schema may not be copied into this project; name its folder in"
                        " CIMDELTA_SCHEMA_DIR, with the files of its zip archive in mof/";
    }
    const auto includes = boost::make_shared<TMofFolders>();
    includes->Add(std::string(folder) + "/mof");
    const auto mof = TInMemNamespace::Create("root/cimv2");
    const TLoadReport report = TMofPopulator(mof, includes).LoadFile(std::string(folder) + "/mof/cim_schema_2.49.0.mof");
    EXPECT_EQ(1631u, report.classes);
    EXPECT_EQ(70u, report.qualifierDecls);
    const auto xml = TInMemNamespace::Create("root/cimv2");
    TCimXmlPopulator(xml).LoadFile(std::string(folder) + "/cim-2.49.0-declarations-pywbem.xml");
    EXPECT_EQ("", DiffDeclarations(*xml, *mof));
}

}  // namespace
}  // namespace NORVZEL20
