#include "embedded/cimxml/TCimXmlTable.h"

#include <gtest/gtest.h>

#include <string>

namespace NORVZEL20 {
namespace {

using T = TCimXmlTable;
using E = TCimXmlElement;

TEST(CimXmlTableTest, EveryElementIsFoundByItsName)
{
    for (unsigned char element = 1; element < E::kCount; ++element) {
        EXPECT_EQ(element, E::Find(E::GetName(static_cast<E::EElement>(element))));
    }
    for (const char* near : {"", "V", "VALU", "VALUES", "value", "VALUE.", "CIM ", "PROPERTY.ARRA"}) {
        EXPECT_EQ(E::kUnknown, E::Find(near)) << near;
    }
}

/// Every pair of a state and an element is either accepted and listed as expected, or refused and not listed.
TEST(CimXmlTableTest, WhatIsAcceptedIsWhatMessagesCallExpected)
{
    for (unsigned char state = 0; state < T::kSkipped; ++state) {
        const std::string expected = T::DescribeExpected(static_cast<T::EState>(state));
        for (unsigned char element = 1; element < E::kCount; ++element) {
            const std::string name = std::string("<") + E::GetName(static_cast<E::EElement>(element)) + ">";
            const bool isAccepted = T::Find(static_cast<T::EState>(state), static_cast<E::EElement>(element)).action != T::kRefuse;
            EXPECT_EQ(isAccepted, expected.find(name) != std::string::npos) << "state " << static_cast<int>(state) << " " << name;
        }
        EXPECT_EQ(T::kRefuse, T::Find(static_cast<T::EState>(state), E::kUnknown).action) << "state " << static_cast<int>(state);
    }
}

TEST(CimXmlTableTest, EveryStateIsReachedFromADocumentOrAnEmbeddedObject)
{
    bool reached[T::kStateCount] = {};
    reached[T::kStart] = reached[T::kEmbedded] = true;
    for (int round = 0; round < T::kStateCount; ++round) {
        for (unsigned char state = 0; state < T::kStateCount; ++state) {
            for (unsigned char element = 1; reached[state] && element < E::kCount; ++element) {
                if (T::Find(static_cast<T::EState>(state), static_cast<E::EElement>(element)).action != T::kRefuse) {
                    reached[T::Find(static_cast<T::EState>(state), static_cast<E::EElement>(element)).next] = true;
                }
            }
        }
    }
    for (int state = 0; state < T::kStateCount; ++state) {
        EXPECT_TRUE(reached[state]) << state;
    }
}

TEST(CimXmlTableTest, WhatIsSkippedAcceptsEverythingAndStaysSkipped)
{
    for (unsigned char element = 0; element < E::kCount; ++element) {
        EXPECT_EQ(T::kSkipped, T::Find(T::kSkipped, static_cast<E::EElement>(element)).next);
        EXPECT_EQ(T::kNothing, T::Find(T::kSkipped, static_cast<E::EElement>(element)).action);
    }
}

TEST(CimXmlTableTest, ExpectedElementsReadAsASentence)
{
    EXPECT_EQ("<DECLARATION> or <MESSAGE>", T::DescribeExpected(T::kCim));
    EXPECT_EQ("<QUALIFIER>, <VALUE> or <VALUE.NULL>", T::DescribeExpected(T::kProperty));
    EXPECT_EQ("nothing", T::DescribeExpected(T::kText));
}

}  // namespace
}  // namespace NORVZEL20
