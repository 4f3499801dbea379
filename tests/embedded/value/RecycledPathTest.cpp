#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "embedded/value/TSharedText.h"
#include "embedded/value/TValueAccess.h"
#include "host/TAddKeyBindingsToMapCallback.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {
namespace {

// A path takes over the memory of one that has ended before it on the same thread.
class RecycledPathTest : public testing::Test {
  protected:
    using TNames = std::vector<std::string>;

    RecycledPathTest() { EndPathOf({"Alpha", "Bravo", "ANameOfMoreThanFifteenCharacters"}); }

    static TCIMReference MakePath(const TNames& names)
    {
        TCIMReference path(boost::shared_ptr<ICIMNamespace>{}, std::map<std::string, TCIMValue>{});
        path.SetClassName("Disk");
        for (const std::string& name : names) {
            path.AddKeyValue(name, TCIMValue("of " + name));
        }
        return path;
    }

    static void EndPathOf(const TNames& names) { MakePath(names); }
};

TEST_F(RecycledPathTest, HasItsOwnKeysAlone)
{
    EXPECT_EQ("Disk", MakePath({}).GetPath());
    EXPECT_EQ("Disk.Bravo=\"of Bravo\"", MakePath({"Bravo"}).GetPath());
    EXPECT_EQ("Disk.alpha=\"of alpha\",bravo=\"of bravo\"", MakePath({"alpha", "bravo"}).GetPath());
    EXPECT_EQ("Disk.A=\"of A\",B=\"of B\",C=\"of C\",D=\"of D\",E=\"of E\"", MakePath({"A", "B", "C", "D", "E"}).GetPath());
    const TCIMReference path = MakePath({"Zulu"});
    EXPECT_EQ(1u, path.GetKeyCount());
    EXPECT_EQ(nullptr, path.FindKeyValue("Alpha"));
    EXPECT_EQ(nullptr, path.FindKeyValue("Bravo"));
    std::map<std::string, TCIMValue> bindings;
    path.EnumerateKeyBindings(TAddKeyBindingsToMapCallback(&bindings));
    EXPECT_EQ(1u, bindings.size());
}

TEST_F(RecycledPathTest, TakesKeysInAnyOrder)
{
    EXPECT_EQ("Disk.A=\"of A\",B=\"of B\",C=\"of C\"", MakePath({"C", "A", "B"}).GetPath());
    EXPECT_EQ("Disk.A=\"of A\",C=\"of C\"", MakePath({"C", "A"}).GetPath());
    TCIMReference path = MakePath({"A", "C"});
    path.AddKeyValue("a", TCIMValue("again"));
    EXPECT_EQ("Disk.A=\"again\",C=\"of C\"", path.GetPath());
}

TEST_F(RecycledPathTest, IsCopiedWithItsOwnKeysAlone)
{
    const TCIMReference path = MakePath({"Bravo"});
    TCIMReference copy = path;
    copy.AddKeyValue("Charlie", TCIMValue("more"));
    EXPECT_EQ("Disk.Bravo=\"of Bravo\",Charlie=\"more\"", copy.GetPath());
    EXPECT_EQ("Disk.Bravo=\"of Bravo\"", path.GetPath());
}

TEST_F(RecycledPathTest, KeepsNoValueOfThePathBefore)
{
    const auto text = TSharedText::Create("a text that only the path has");
    {
        TCIMReference path = MakePath({});
        path.AddKeyValue("Alpha", TValueAccess::FromSharedText(text));
        EXPECT_FALSE(text->IsUnique());
    }
    EXPECT_TRUE(text->IsUnique());
}

}  // namespace
}  // namespace NORVZEL20
