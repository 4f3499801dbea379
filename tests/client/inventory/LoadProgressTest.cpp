#include "client/inventory/TLoadProgress.h"

#include <gtest/gtest.h>

#include "client/inventory/TInventoryFile.h"
#include "client/inventory/TInventoryLoader.h"
#include "tests/client/SourcesOf.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

class LoadProgressTest : public TClientFixture {
  protected:
    /// Adds an inventory of files of these sizes.
    void Add(const std::string& label, const std::vector<std::size_t>& sizes)
    {
        TInventory inventory{};
        inventory.label = label;
        for (const std::size_t size : sizes) {
            inventory.files.push_back(Scratch(label + std::to_string(inventory.files.size()) + ".xml", std::string(size, 'x')));
        }
        fInventories.push_back(inventory);
    }

    void AddStandardInput()
    {
        TInventory inventory{};
        inventory.files = {"-"};
        fInventories.push_back(inventory);
    }

    static std::string WithoutPrefix(const std::string& text)
    {
        return Shorten(text, "cimdelta-test-" + std::to_string(getpid()) + "-", "");
    }

    std::vector<TInventory> fInventories;
};

TEST_F(LoadProgressTest, AFileIsShownByItsShareAndItsPlaceAmongTheInventories)
{
    Add("a", {1000});
    Add("web17-", {2500000});
    Add("c", {10});
    TLoadProgress progress(fInventories);
    EXPECT_EQ("", progress.Describe());
    progress.Start(0);
    progress.Start(1);
    progress.BytesOf(0) += 500;
    EXPECT_EQ("a0.xml 50 % (0 of 1 kB), 1 of 3", WithoutPrefix(progress.Describe()));
    progress.End(0);
    progress.BytesOf(1) += 1600000;
    EXPECT_EQ("web17-0.xml 64 % (1 of 2 MB), 2 of 3", WithoutPrefix(progress.Describe()));
    progress.End(1);
    EXPECT_EQ("", progress.Describe());
    progress.Start(2);
    progress.BytesOf(2) += 20;
    EXPECT_EQ("c0.xml 100 % (0 of 0 kB), 3 of 3", WithoutPrefix(progress.Describe())) << "a file may grow while it is read";
}

TEST_F(LoadProgressTest, SeveralFilesAreShownByTheirSum)
{
    Add("web01", {60000, 40000});
    TLoadProgress progress(fInventories);
    progress.Start(0);
    progress.BytesOf(0) += 75000;
    EXPECT_EQ("web01 75 % (75 of 100 kB)", progress.Describe());
}

TEST_F(LoadProgressTest, StandardInputHasNoShare)
{
    AddStandardInput();
    TLoadProgress progress(fInventories);
    progress.Start(0);
    progress.BytesOf(0) += 112000000;
    EXPECT_EQ("standard input 112 MB", progress.Describe());
}

TEST_F(LoadProgressTest, TheBytesOfCompressedFilesAreCountedAsTheyAreStored)
{
    for (const char* const name : {"web02.xml", "web02.xml.gz", "web02.xml.xz", "web02.xml.zst"}) {
        TByteCount count{0};
        TInventoryFile file(name, &count);
        char block[512];
        while (file.Read(block, sizeof block) > 0) {
        }
        EXPECT_EQ(ReadFile(name).size(), count) << name;
    }
}

}  // namespace
}  // namespace NORVZEL20
