#include "client/noise/FindTops.h"

#include <gtest/gtest.h>

namespace NORVZEL20 {
namespace {

/// Root, A above B (above C and D) and E; F beside A. B and those below it declare the property.
class FindTopsTest : public ::testing::Test {
  protected:
    FindTopsTest()
    {
        Add("<root>", 0, 7);
        Add("A", 0, 6);
        Add("B", 1, 5);
        Add("C", 2, 4);
        Add("D", 2, 5);
        Add("E", 1, 6);
        Add("F", 0, 7);
    }

    void Add(const std::string& name, std::size_t parent, std::size_t end)
    {
        TRulesDraft::TClass cls;
        cls.name = name;
        cls.parent = parent;
        cls.treeEnd = end;
        fClasses.push_back(cls);
    }

    /// "B: B C D", the class of each rule and those that it is for.
    std::string Tops(const std::set<std::size_t>& showing, const std::set<std::size_t>& relevant)
    {
        std::string text;
        for (const auto& [top, end] : FindTops(fClasses, showing, relevant, [](std::size_t above) { return above >= 2; })) {
            text += text.empty() ? "" : ", ";
            for (std::size_t position = top; position < end; ++position) {
                text += fClasses[position].name;
            }
        }
        return text;
    }

    std::vector<TRulesDraft::TClass> fClasses;
};

TEST_F(FindTopsTest, TheHighestClassThatDeclaresItStandsForAllIfAllShowIt)
{
    EXPECT_EQ("BCD", Tops({3, 4}, {3, 4}));
    EXPECT_EQ("BCD", Tops({2, 3, 4}, {2, 3, 4}));
}

TEST_F(FindTopsTest, OneClassAloneStandsForItself)
{
    EXPECT_EQ("C", Tops({3}, {3}));
    EXPECT_EQ("C, F", Tops({3, 6}, {3, 6}));
}

TEST_F(FindTopsTest, AClassThatDoesNotShowItIsNotMeant)
{
    EXPECT_EQ("C", Tops({3}, {3, 4}));
    EXPECT_EQ("B, C", Tops({2, 3}, {2, 3, 4}));
}

TEST_F(FindTopsTest, AClassWithInstancesStandsForThoseBelowItWithoutAny)
{
    EXPECT_EQ("BCD", Tops({2}, {2}));
}

}  // namespace
}  // namespace NORVZEL20
