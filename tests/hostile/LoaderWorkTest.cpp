// Documents that could make the loader repeat work for each instance or class: its steps are counted.
#include <gtest/gtest.h>

#include "embedded/cimxml/TXmlReader.h"
#include "embedded/load/TLoader.h"
#include "embedded/value/EraseLast.h"

namespace NORVZEL20 {

namespace {

struct TNoSink : IXmlSink {
    void OnStart(const char*, const char**) override {}
    void OnEnd(const char*) override {}
    void OnText(const char*, std::size_t) override {}
};

/// A loader that gets classes and instances one after the other, as from a document.
class LoaderWorkTest : public testing::Test {
  protected:
    LoaderWorkTest() { fContext.BeginDocument("hostile.xml", fXml); }

    void Class(const std::string& name, const std::string& super = std::string())
    {
        TDraft draft{TEmbeddedObject(name, true), {}, {}, {}};
        draft.object.SetSuperClassName(super);
        fLoader.AddClass(std::move(draft));
    }

    /// Whether the class of an instance is known, so that it can be filled.
    bool Instance(const std::string& className) { return fLoader.BeginInstance(className.c_str()); }

    void Finish()
    {
        fLoader.Finish([](const TCIMValue& value) { return value; });
    }

    boost::shared_ptr<TInMemNamespace> fNamespace = TInMemNamespace::Create("root/cimv2");
    TNoSink fSink;
    TXmlReader fXml{fSink};
    TLoadContext fContext;
    TLoader fLoader{fContext, fNamespace};
};

std::string Name(std::size_t number)
{
    return "C" + std::to_string(number);
}

constexpr std::size_t kMany = 2000;

}  // namespace

TEST_F(LoaderWorkTest, ClassesBetweenInstancesAreTriedOnce)
{
    for (std::size_t number = 0; number < kMany; ++number) {
        Class(Name(number));
        EXPECT_TRUE(Instance(Name(number)));
    }
    Finish();
    EXPECT_GE(fLoader.CountTried(), kMany);
    EXPECT_LE(fLoader.CountTried(), 4 * kMany);
}

TEST_F(LoaderWorkTest, ClassesThatWaitForTheirSuperclassAreNotTriedAgainForEachInstance)
{
    for (std::size_t number = 0; number < kMany; ++number) {
        Class("Waiting" + Name(number), "Late");
    }
    for (std::size_t number = 0; number < kMany; ++number) {
        Class(Name(number));
        EXPECT_TRUE(Instance(Name(number)));
    }
    Class("Late");
    EXPECT_TRUE(Instance("Waiting" + Name(7)));
    Finish();
    EXPECT_GE(fLoader.CountTried(), 2 * kMany);
    EXPECT_LE(fLoader.CountTried(), 12 * kMany);
    EXPECT_EQ(2 * kMany + 1, fNamespace->GetClasses().size());
}

TEST_F(LoaderWorkTest, ALongChainWithoutATopIsGoneOverOnce)
{
    for (std::size_t number = kMany; number > 0; --number) {
        Class(Name(number), Name(number - 1));
    }
    EXPECT_THROW(Finish(), TPopulateError);
    EXPECT_GE(fLoader.CountTried(), kMany);
    EXPECT_LE(fLoader.CountTried(), 4 * kMany);
}

/// A failed load takes back what it added in reverse order.
TEST(EraseLastTest, TheLastElementIsFoundAtOnce)
{
    std::vector<int> list;
    for (int number = 0; number < 100; ++number) {
        list.push_back(number);
    }
    std::size_t asked = 0;
    for (int number = 99; number >= 10; --number) {
        EraseLast(list, [&](int other) { return ++asked > 0 && other == number; });
    }
    EXPECT_EQ(90U, asked);
    EXPECT_EQ(10U, list.size());
    EraseLast(list, [](int other) { return other % 2 == 0; });
    EXPECT_EQ((std::vector<int>{0, 1, 2, 3, 4, 5, 6, 7, 9}), list);
    EraseLast(list, [](int) { return false; });
    EXPECT_EQ(9U, list.size());
}

}  // namespace NORVZEL20
