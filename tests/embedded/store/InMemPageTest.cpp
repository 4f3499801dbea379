#include "embedded/store/TInMemPage.h"

#include "embedded/store/TInMemPages.h"
#include "embedded/value/TSharedText.h"
#include "embedded/value/TValueAccess.h"
#include "tests/embedded/store/TInMemFixture.h"
#include "tests/support/HeapInUse.h"

namespace NORVZEL20 {
namespace {

const char* AddressOf(const void* object)
{
    return static_cast<const char*>(object);
}

TEST(InMemPage, BlocksLieSideBySideUntilThereIsNoRoom)
{
    const auto page = TInMemPage::Create(96);
    void* const first = page->Take(40);
    EXPECT_EQ(first, page->GetLast());
    void* const second = page->Take(48);
    EXPECT_EQ(second, page->GetLast());
    EXPECT_EQ(40, AddressOf(second) - AddressOf(first));
    EXPECT_TRUE(page->HasRoomFor(8));
    EXPECT_FALSE(page->HasRoomFor(16));
    TInMemPage::Drop(page.get());
    TInMemPage::Drop(page.get());
}

TEST(InMemPage, TheLastUseFreesThePage)
{
    const std::size_t before = HeapInUse();
    auto pointer = TInMemPage::Create(4000);
    TInMemPage* const page = pointer.get();
    page->Take(40);
    page->Take(40);
    pointer.reset();
    TInMemPage::Drop(page);
    EXPECT_LE(before + 4000, HeapInUse());
    TInMemPage::Drop(page);
    EXPECT_EQ(before, HeapInUse());
}

TEST(InMemPages, GrowWithTheClassUpToAPage)
{
    constexpr std::size_t kBlock = 400;
    TInMemPages pages;
    std::string blocksOfPages;
    std::vector<TInMemPage::TPointer> kept;
    for (int block = 0; block < 60; ++block) {
        TInMemPage& page = pages.GetPageFor(kBlock);
        if (kept.empty() || kept.back().get() != &page) {
            kept.emplace_back(&page);
            blocksOfPages += ' ';
        }
        blocksOfPages += '|';
        page.Take(kBlock);
        TInMemPage::Drop(&page);  // the block; `kept` has the page
    }
    EXPECT_EQ(" | | | | || ||| |||| |||||| ||||||||| |||||||||| |||||||||| |||||||||| ||", blocksOfPages);
}

TEST(InMemPages, ABlockLargerThanAPageHasOneOfItsOwn)
{
    TInMemPages pages;
    for (int block = 0; block < 3; ++block) {
        TInMemPage& page = pages.GetPageFor(2 * TInMemPage::kMostBytes);
        EXPECT_TRUE(page.HasRoomFor(2 * TInMemPage::kMostBytes));
        page.Take(2 * TInMemPage::kMostBytes);
        EXPECT_FALSE(page.HasRoomFor(8));
        TInMemPage::Drop(&page);
    }
}

class InMemPlacesTest : public TInMemFixture {
  protected:
    TClassPointer DeclareDisk(const std::string& name)
    {
        auto cls = Allocate(name, nullptr, {{"Id", TType::kString, {"Key"}}, {"Size", TType::kUint64, {}}});
        cls->AddToNamespace(kNoContext);
        return cls;
    }
};

TEST_F(InMemPlacesTest, InstancesOfAClassLieSideBySideWhateverIsMadeBetweenThem)
{
    const std::vector<TClassPointer> classes = {DeclareDisk("Disk"), DeclareDisk("Tape"), DeclareDisk("Drum")};
    std::vector<TInstancePointer> instances;
    int neighbours = 0;
    constexpr int kOfEachClass = 300;
    for (std::size_t number = 0; number < kOfEachClass * classes.size(); ++number) {
        instances.push_back(classes[number % classes.size()]->AllocateInMemInstance());
        if (number >= classes.size()) {
            const TInMemInstance* const before = instances[number - classes.size()].get();
            const std::ptrdiff_t distance = AddressOf(instances.back().get()) - AddressOf(before);
            neighbours += distance > 0 && distance < 256 ? 1 : 0;  // an instance of two properties takes less
        }
    }
    // All but the first of each page.
    EXPECT_LE(kOfEachClass * 3 * 9 / 10, neighbours);
}

TEST_F(InMemPlacesTest, AnInstanceEndsAlthoughItsNeighboursLive)
{
    const auto cls = DeclareDisk("Disk");
    std::vector<TInstancePointer> instances;
    for (int number = 0; number < 100; ++number) {
        instances.push_back(cls->AllocateInMemInstance());
    }
    const auto text = TSharedText::Create("a text that only the instance has");
    instances[50]->SetSlot(0, TValueAccess::FromSharedText(text));
    EXPECT_FALSE(text->IsUnique());
    instances[50].reset();
    EXPECT_TRUE(text->IsUnique());
    instances[49]->SetSlot(1, Uint64(49));
    instances[51]->SetSlot(1, Uint64(51));
    EXPECT_EQ("49", instances[49]->GetSlotValue(1).ToText());
    EXPECT_EQ("51", instances[51]->GetSlotValue(1).ToText());
}

TEST_F(InMemPlacesTest, AnInstanceKeepsNoMoreThanItsPage)
{
    const auto cls = DeclareDisk("Disk");
    std::vector<TInstancePointer> instances;
    instances.reserve(1000);
    const std::size_t before = HeapInUse();
    for (int number = 0; number < 1000; ++number) {
        instances.push_back(cls->AllocateInMemInstance());
    }
    const TInstancePointer kept = instances[500];
    instances.clear();
    // Its page, and the one that the class is filling.
    EXPECT_GE(before + 2 * (TInMemPage::kMostBytes + 32), HeapInUse());
}

TEST_F(InMemPlacesTest, TheOnlyInstanceOfAClassTakesNoPage)
{
    const auto cls = DeclareDisk("Disk");
    const std::size_t before = HeapInUse();
    const auto instance = cls->AllocateInMemInstance();
    EXPECT_GT(before + 256, HeapInUse());
}

}  // namespace
}  // namespace NORVZEL20
