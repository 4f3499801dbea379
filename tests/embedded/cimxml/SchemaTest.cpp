#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

/// The published qualifier declarations are not part of this project: the environment says where they are.
TEST(SchemaTest, ThePublishedQualifiersLoadAndComeBackEqual)
{
    const char* folder = std::getenv("CIMDELTA_SCHEMA_DIR");
    if (folder == nullptr) {
        GTEST_SKIP()
            << "NOT CHECKED: the DMTF's schema may not be copied into this project; name its folder in CIMDELTA_SCHEMA_DIR";
    }
    TLoading loading;
    const TLoadReport report = loading.LoadFile(std::string(folder) + "/cim-2.49.0-qualifiers.xml");
    EXPECT_EQ(70u, report.qualifierDecls);
    TLoading again;
    again.Load(loading.Write());
    EXPECT_EQ(loading.Write(), again.Write());
}

}  // namespace
}  // namespace NORVZEL20
