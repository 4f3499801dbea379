#include "engine/Borrow.h"

#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>

namespace NORVZEL20 {
namespace {

TEST(Borrow, PointsToTheSameWithoutAUse)
{
    const auto owner = boost::make_shared<int>(5);
    const boost::shared_ptr<int> borrowed = Borrow(owner);
    const boost::shared_ptr<int> copy = borrowed;
    EXPECT_EQ(owner.get(), borrowed.get());
    EXPECT_EQ(owner.get(), copy.get());
    EXPECT_EQ(1, owner.use_count());
    EXPECT_EQ(0, copy.use_count());
}

TEST(Borrow, OfNullIsNull)
{
    EXPECT_FALSE(Borrow(boost::shared_ptr<int>()));
}

}  // namespace
}  // namespace NORVZEL20
