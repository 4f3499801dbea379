#include <gtest/gtest.h>

#include <fstream>
#include <iostream>
#include <sstream>

#include "host/TOSSpecific.h"
#include "provider/TDeltaNamespaceProvider.h"
#include "tests/faults/FailEachAllocation.h"
#include "tests/faults/TFaultyStream.h"
#include "tests/faults/TOpenHook.h"
#include "tests/support/TCapturingLogger.h"

namespace NORVZEL20 {
namespace {

/// The file of the delta schema, which every new delta namespace reads.
class TSchemaFileFixture : public testing::Test {
  protected:
    TSchemaFileFixture()
    {
        std::ostringstream text;
        text << std::ifstream(fPath, std::ios::binary).rdbuf();
        fContents = text.str();
    }

    /// Returns "", or for example `status 11`.
    static std::string Allocate()
    {
        return OutcomeOf([] { TDeltaNamespaceProvider::GetInstance()->AllocateNamespace({}, false, "root/delta"); });
    }

    /// As Allocate, but the file is `stream`.
    std::string AllocateFrom(TFaultyStream& stream) const
    {
        const TOpenHook hook(fPath, [&stream](const char*) { return stream.Open(); });
        return Allocate();
    }

    const std::string fPath = TOSSpecific::GetZELRootPath() + "/data/deltaclasses.properties.xml";
    std::string fContents;
    TCapturingLogger fLog;
};
using SchemaFile = TSchemaFileFixture;

TEST_F(SchemaFile, IsReadInWhateverPieces)
{
    TFaultyStream stream(fContents, 11);
    EXPECT_EQ("", AllocateFrom(stream));
    EXPECT_FALSE(stream.IsOpen());
    EXPECT_EQ("", fLog.Take());
}

TEST_F(SchemaFile, ErrorAnywhereKeepsTheNamespaceFromBeingMadeAndLeavesNothing)
{
    std::size_t errors = 0;
    for (std::size_t offset = 0; offset < fContents.size(); offset += 16) {
        const TFailingAllocator::TUsage before = TFailingAllocator::GetLive();
        {
            TFaultyStream stream(fContents, 512, offset);
            ASSERT_EQ("status 11", AllocateFrom(stream)) << "error at " << offset;
            ASSERT_FALSE(stream.IsOpen());
            ASSERT_EQ("0|" + fPath + ": cannot read the file: Input/output error|", fLog.Take());
        }
        if (errors++ > 0) {
            ASSERT_EQ(before.bytes, TFailingAllocator::GetLive().bytes);
        }
    }
    EXPECT_EQ("", Allocate());
    std::cout << "schema file: " << errors << " read errors\n";
    RecordProperty("SchemaReadErrors", std::to_string(errors));
}

TEST_F(SchemaFile, ThatIsCutOffKeepsTheNamespaceFromBeingMade)
{
    const std::size_t end = fContents.rfind('>');
    for (std::size_t length = 0; length <= end; length += 97) {
        TFaultyStream stream(fContents.substr(0, length), 4096);
        ASSERT_EQ("status 9", AllocateFrom(stream)) << length;
        ASSERT_NE("", fLog.Take());
    }
    EXPECT_EQ("", Allocate());
}

}  // namespace
}  // namespace NORVZEL20
