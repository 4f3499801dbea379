#include "client/comparison/TInstanceIndex.h"

#include <map>

#include "client/inventory/TInventoryLoader.h"
#include "embedded/store/TInMemClass.h"
#include "tests/client/Documents.h"
#include "tests/client/SourcesOf.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

/// Indexes of four disks, by keys that the test chooses.
class InstanceIndexTest : public TClientFixture {
  protected:
    void SetUp() override
    {
        TClientFixture::SetUp();
        std::string contents = System() + Class("Disk", "", KeyProperty("Id") + Declaration("Vendor", "string"));
        for (const char* const id : {"sdd", "sda", "sdc", "sdb"}) {
            contents += Instance("Disk", Value("Id", id) + Value("Vendor", id < std::string("sdc") ? "Acme" : "Zeta"));
        }
        TFakeConsole console;
        fInventory = TInventoryLoader(console).LoadOne(SourcesOf({Scratch("disks.xml", Document(contents))}).front());
    }

    static std::string TextOf(const ICIMInstance& instance, const char* property)
    {
        return instance.GetProperty(property, TCallContext())->GetValue(TCallContext()).ToText();
    }

    TInstanceIndex IndexBy(const char* property)
    {
        return TInstanceIndex(fInventory.ns->FindClass("Disk"), [this, property](const boost::shared_ptr<ICIMInstance>& disk) {
            ++fKeysMade;
            return fAllHashesAreEqual ? "one text" : TextOf(*disk, property);
        });
    }

    static std::string Ids(const TInstanceIndex::TInstances& disks)
    {
        std::string ids;
        for (const boost::shared_ptr<ICIMInstance>& disk : disks) {
            ids += TextOf(*disk, "Id") + " ";
        }
        return ids;
    }

    static std::string All(const TInstanceIndex& index)
    {
        std::map<std::string, std::string> all;
        index.ForEachKey([&all](const std::string& key, const TInstanceIndex::TInstances& disks) {
            EXPECT_EQ(0u, all.count(key)) << key;
            all[key] = Ids(disks);
        });
        std::string text;
        for (const auto& [key, ids] : all) {
            text += key + ": " + ids;
        }
        return text;
    }

    TInventory fInventory;
    bool fAllHashesAreEqual = false;
    int fKeysMade = 0;
};

TEST_F(InstanceIndexTest, FindsInstancesInTheOrderOfTheNamespace)
{
    TInstanceIndex index = IndexBy("Vendor");
    EXPECT_EQ("sda sdb ", Ids(index.Find("Acme")));
    EXPECT_EQ("sdd sdc ", Ids(index.Find("Zeta")));
    EXPECT_EQ("", Ids(index.Find("Nobody")));
    EXPECT_EQ("Acme: sda sdb Zeta: sdd sdc ", All(index));
}

TEST_F(InstanceIndexTest, KeysWithTheSameHashAreDifferent)
{
    fAllHashesAreEqual = true;
    TInstanceIndex index = IndexBy("Vendor");
    fAllHashesAreEqual = false;
    EXPECT_EQ("Acme: sda sdb Zeta: sdd sdc ", All(index));
    EXPECT_EQ("", Ids(index.Find("one text")));
}

TEST_F(InstanceIndexTest, TheKeyOfTheLastCallIsFoundWithoutWork)
{
    TInstanceIndex index = IndexBy("Vendor");
    EXPECT_EQ(4, fKeysMade);
    index.Find("Zeta");
    EXPECT_EQ(6, fKeysMade);
    EXPECT_EQ("sdd sdc ", Ids(index.Find("Zeta")));
    EXPECT_EQ(6, fKeysMade);
    EXPECT_EQ("sda sdb ", Ids(index.Find("Acme")));
    EXPECT_EQ(8, fKeysMade);
    EXPECT_EQ("", Ids(index.Find("Nobody")));
    EXPECT_EQ("sdd sdc ", Ids(index.Find("Zeta")));
}

TEST_F(InstanceIndexTest, IsEmptyWithoutAClass)
{
    TInstanceIndex index(nullptr, [](const boost::shared_ptr<ICIMInstance>&) { return std::string(); });
    EXPECT_EQ("", Ids(index.Find("")));
    EXPECT_EQ("", All(index));
}

}  // namespace
}  // namespace NORVZEL20
