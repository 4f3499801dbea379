// Values and patterns that could make comparing or matching repeat work: the bytes allocated are counted.
#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/query/TLikePattern.h"
#include "embedded/value/TEmbeddedObject.h"
#include "tests/hostile/TMemoryMeter.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kObjects = 2000;

}  // namespace

/// Two bags of the same objects in opposite order: each object is compared with its own counterpart.
TEST(BagTest, BagsOfObjectsThatDifferInTheirArraysAreComparedInProportion)
{
    std::vector<TCIMValue> objects;
    for (unsigned int number = 0; number < kObjects; ++number) {
        TEmbeddedObject object("X");
        TEmbeddedObject::TProperty property;
        property.name = "P";
        property.value = TCIMValue(TCIMValue::TCIMType::kArrayUint32, 2, {TCIMValue(number), TCIMValue(7U)});
        object.AddProperty(std::move(property));
        objects.emplace_back(boost::make_shared<const TEmbeddedObject>(std::move(object)));
    }
    const auto bagOf = [](const std::vector<TCIMValue>& elements) {
        return TCIMValue(TCIMValue::TCIMType::kArrayString, kObjects, elements).AsBag();
    };
    const TCIMValue bag = bagOf(objects);
    const TCIMValue reversed = bagOf({objects.rbegin(), objects.rend()});
    TMemoryMeter meter;
    EXPECT_TRUE(bag == reversed);
    EXPECT_LT(meter.GetTotal(), 1000 * kObjects);  // a comparison of two objects allocates
}

TEST(LikeTest, BracketsThatAreNotClosedAreReadOnce)
{
    const std::string pattern(20000, '[');
    TMemoryMeter meter;
    const TLikePattern like(pattern);
    EXPECT_LT(meter.GetTotal(), 500 * pattern.size());
    EXPECT_TRUE(like.Matches(pattern));
}

}  // namespace NORVZEL20
