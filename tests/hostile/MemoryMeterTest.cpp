// The meter itself: if it counted nothing, all upper bounds would hold.
#include <gtest/gtest.h>
#include <malloc.h>

#include <cstdlib>
#include <functional>
#include <memory>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "fuzz/SampleInventory.h"
#include "tests/hostile/DocumentParts.h"
#include "tests/hostile/TMemoryMeter.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kMuch = 10 * kMegabyte;

struct alignas(4096) TPage {
    char bytes[4096];
};

void* AllocateByPosix()
{
    void* block = nullptr;
    return posix_memalign(&block, 4096, kMuch) == 0 ? block : nullptr;
}

void* Grow()
{
    return std::realloc(std::malloc(kMegabyte), kMuch);
}

}  // namespace

TEST(MemoryMeterTest, EveryWayToAllocateCounts)
{
    const struct {
        const char* name;
        std::function<void*()> allocate;
        std::function<void(void*)> release;
    } rows[] = {
        {"malloc", [] { return std::malloc(kMuch); }, std::free},
        {"calloc", [] { return std::calloc(10, kMegabyte); }, std::free},
        {"realloc", Grow, std::free},
        {"memalign", [] { return memalign(4096, kMuch); }, std::free},
        {"aligned_alloc", [] { return std::aligned_alloc(4096, kMuch); }, std::free},
        {"posix_memalign", AllocateByPosix, std::free},
        {"new", [] { return new char[kMuch]; }, [](void* block) { delete[] static_cast<char*>(block); }},
        {"aligned new", [] { return new TPage[kMuch / 4096]; }, [](void* block) { delete[] static_cast<TPage*>(block); }},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        const TMemoryMeter meter;
        for (const std::size_t times : {1, 2}) {
            void* volatile block = row.allocate();
            ASSERT_NE(nullptr, block);
            row.release(block);
            EXPECT_GE(meter.GetPeak(), kMuch);
            EXPECT_LE(meter.GetPeak(), kMuch + 2 * kMegabyte);
            EXPECT_GE(meter.GetTotal(), times * kMuch);
        }
    }
}

TEST(MemoryMeterTest, WhatIsFreedLeavesThePeakAndTheTotal)
{
    const TMemoryMeter meter;
    for (int i = 0; i < 10; ++i) {
        void* volatile block = std::malloc(kMegabyte);
        std::free(block);
    }
    EXPECT_GE(meter.GetPeak(), kMegabyte);
    EXPECT_LE(meter.GetPeak(), 2 * kMegabyte);
    EXPECT_GE(meter.GetTotal(), kMuch);
    EXPECT_LE(meter.GetTotal(), kMuch + kMegabyte);
}

/// Freed memory from before the start must not hide what comes after it.
TEST(MemoryMeterTest, WhatWasThereBeforeDoesNotCount)
{
    auto before = std::make_unique<char[]>(kMuch);
    const TMemoryMeter meter;
    before.reset();
    EXPECT_LE(meter.GetPeak(), kMegabyte);
    before = std::make_unique<char[]>(kMuch);
    EXPECT_LE(meter.GetPeak(), kMegabyte);
    const auto more = std::make_unique<char[]>(kMuch);
    EXPECT_GE(meter.GetPeak(), kMuch);
}

/// Memory of the host's library counts (it keeps the value), and of the XML library (its buffer holds the tag).
TEST(MemoryMeterTest, MemoryOfTheLibrariesCounts)
{
    const std::string head = "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>";
    const std::string tail = "<QUALIFIER.DECLARATION NAME=\"Other\" TYPE=\"boolean\"/></DECLGROUP></DECLARATION></CIM>";
    const std::string instance = head +
                                 "<VALUE.OBJECT><INSTANCE CLASSNAME=\"Device\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><VALUE>" +
                                 std::string(kMuch, 'x') + "</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>" + tail;
    const std::string attribute = "<CIM x=\"" + std::string(kMuch, 'x') + "\"" + (head.c_str() + 4) + tail;
    for (const std::string& document : {instance, attribute}) {
        const boost::shared_ptr<TInMemNamespace> ns = LoadSample();
        const TMemoryMeter meter;
        TCimXmlPopulator(ns).LoadFromMemory(document.data(), document.size(), "much.xml");
        EXPECT_GE(meter.GetPeak(), kMuch);
        EXPECT_GE(meter.GetTotal(), kMuch);
        EXPECT_LE(meter.GetTotal(), 10 * kMuch);
    }
}

}  // namespace NORVZEL20
