#include "client/inventory/InventoryLabels.h"

#include <gtest/gtest.h>

#include <boost/algorithm/string/join.hpp>

namespace NORVZEL20 {
namespace {

std::string Labels(const std::vector<std::string>& paths)
{
    return boost::algorithm::join(MakeInventoryLabels(paths), "|");
}

TEST(InventoryLabels, AreFileNamesWithoutDirectoryAndSuffixes)
{
    EXPECT_EQ("web01|web02|web03|web04.example.org",
              Labels({"/srv/web01.xml", "web02.xml.gz", "../x/web03.cimxml.xz", "web04.example.org.xml.zst"}));
}

TEST(InventoryLabels, ArePathsWhereNamesAreAlike)
{
    EXPECT_EQ("old/web01.xml|new/web01.xml|b", Labels({"old/web01.xml", "new/web01.xml", "b.xml"}));
}

TEST(InventoryLabels, AreNumberedWherePathsAreAlike)
{
    EXPECT_EQ("a.xml|a.xml#2|a.xml#3", Labels({"a.xml", "a.xml", "a.xml"}));
}

TEST(InventoryLabels, KeepWhatWouldBecomeEmpty)
{
    EXPECT_EQ(".xml|stdin|dir/", Labels({".xml", "-", "dir/"}));
}

TEST(InventoryLabels, NumberedOnesDoNotCollideWithOthers)
{
    EXPECT_EQ("a#2|a|a#3", Labels({"a#2", "a", "a"}));
}

}  // namespace
}  // namespace NORVZEL20
