#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <string>
#include <utility>
#include <vector>

#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TSharedText.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/TValueText.h"
#include "host/TCIMReference.h"
#include "tests/embedded/value/DateTimeOf.h"

namespace NORVZEL20 {
namespace {

TCIMReference Disk(const std::vector<std::pair<std::string, TCIMValue>>& keys)
{
    TCIMReference path;
    path.SetClassName("Disk");
    for (const auto& [name, value] : keys) {
        path.AddKeyValue(name, value);
    }
    return path;
}

/// GetPath has a short way for plain text; AppendPath always goes the long one.
std::string LongWay(const TCIMReference& path)
{
    std::string text = "before ";
    path.AppendPath(text);
    return text.substr(7);
}

struct TKey {
    TCIMValue value;
    std::string text;
};

/// A key of every kind.
std::vector<TKey> Keys()
{
    const std::string longText(70, 'x');
    return {{TCIMValue("sda"), "\"sda\""},
            {TCIMValue(""), "\"\""},
            {TCIMValue("thirteen char"), "\"thirteen char\""},
            {TCIMValue("fourteen chars"), "\"fourteen chars\""},
            {TCIMValue(longText), "\"" + longText + "\""},
            {TValueAccess::FromSharedText(TSharedText::Create("text that is shared")), "\"text that is shared\""},
            {TCIMValue(std::string("a\0b", 3)), std::string("\"a\0b\"", 5)},
            {TCIMValue("sechs \xC3\x9F und vier"), "\"sechs \xC3\x9F und vier\""},
            {TCIMValue("a\"b"), "\"a\\\"b\""},
            {TCIMValue("\\"), "\"\\\\\""},
            {TCIMValue(longText + "\""), "\"" + longText + "\\\"\""},
            {TCIMValue(7), "7"},
            {TCIMValue(-7), "-7"},
            {TCIMValue(0.5), "0.5"},
            {TCIMValue(true), "TRUE"},
            {TCIMValue(u'c'), "'c'"},
            {TCIMValue(DateTimeOf("20240101120000.000000+060")), "\"20240101110000.000000+000\""},
            {TCIMValue(static_cast<const TCIMReference&>(Disk({{"Id", TCIMValue("a")}}))), "\"Disk.Id=\\\"a\\\"\""},
            {TCIMValue(TCIMValue::TCIMType::kUint8, 1, {TCIMValue(static_cast<std::uint8_t>(1))}), "{1}"},
            {TCIMValue::Null(TCIMValue::TCIMType::kString), "NULL"}};
}

TEST(PathText, EachKindOfKeyHasItsTextInBothWays)
{
    for (const TKey& key : Keys()) {
        const TCIMReference path = Disk({{"Id", key.value}});
        EXPECT_EQ("Disk.Id=" + key.text, path.GetPath());
        EXPECT_EQ(path.GetPath(), LongWay(path));
    }
}

TEST(PathText, TwoKeysOfAnyKindsHaveTheirTextsInBothWays)
{
    for (const TKey& first : Keys()) {
        for (const TKey& second : Keys()) {
            const TCIMReference path = Disk({{"Unit", second.value}, {"Controller", first.value}});
            EXPECT_EQ("Disk.Controller=" + first.text + ",Unit=" + second.text, path.GetPath());
            EXPECT_EQ(path.GetPath(), LongWay(path));
        }
    }
}

TEST(PathText, KeysAddedInAnyOrderComeInTheOrderOfTheirNames)
{
    EXPECT_EQ("Disk.A=1,b=2,C=3,d=4", Disk({{"C", 3}, {"A", 1}, {"d", 4}, {"b", 2}}).GetPath());
    EXPECT_EQ("Disk.A=1,b=2,C=3,d=4", Disk({{"A", 1}, {"b", 2}, {"C", 3}, {"d", 4}}).GetPath());
    EXPECT_EQ("Disk.A=1,b=9", Disk({{"A", 1}, {"b", 2}, {"B", 9}}).GetPath());
}

TEST(PathText, APathWithoutKeysClassOrContentsHasItsTextInBothWays)
{
    TCIMReference noClass;
    noClass.AddKeyValue("Id", TCIMValue("a"));
    TCIMReference placed = Disk({{"Id", TCIMValue("a")}});
    placed.SetNamespaceName("Root/CIMv2");
    const std::vector<std::pair<TCIMReference, std::string>> paths = {
        {TCIMReference(), ""}, {Disk({}), "Disk"}, {noClass, ".Id=\"a\""}, {placed, "root/cimv2:Disk.Id=\"a\""}};
    for (const auto& [path, text] : paths) {
        EXPECT_EQ(text, path.GetPath());
        EXPECT_EQ(text, LongWay(path));
    }
}

TEST(PathText, AQuoteOrBackslashIsFoundAtEachPlace)
{
    for (std::size_t length = 1; length < 40; ++length) {
        for (std::size_t at = 0; at < length; ++at) {
            std::string text(length, 'x');
            for (const char c : {'!', '#', '[', ']', '\xA2', '\xDC', '\0', '\x80', '\xFF'}) {
                text[at] = c;
                EXPECT_FALSE(TValueText::NeedsEscape(text, '"')) << text;
            }
            text[at] = '"';
            EXPECT_TRUE(TValueText::NeedsEscape(text, '"')) << text;
            EXPECT_FALSE(TValueText::NeedsEscape(text, '\'')) << text;
            text[at] = '\\';
            EXPECT_TRUE(TValueText::NeedsEscape(text, '"')) << text;
        }
    }
    EXPECT_FALSE(TValueText::NeedsEscape("", '"'));
}

/// The contents of a path that ends are used again by the next one that is made without a namespace.
TEST(PathText, APathHasNothingOfThoseThatEndedBefore)
{
    for (int round = 0; round < 10; ++round) {
        {
            TCIMReference outer = Disk({{"Unit", TCIMValue(static_cast<const TCIMReference&>(Disk({{"Id", TCIMValue("a")}})))}});
            outer.SetNamespaceName("root/cimv2");
            outer.SetHost("web01");
            EXPECT_EQ("//web01/root/cimv2:Disk.Unit=\"Disk.Id=\\\"a\\\"\"", outer.GetPath());
            TCIMReference large(boost::shared_ptr<ICIMNamespace>{}, {});
            for (char name = 'A'; name < 'A' + 20; ++name) {
                large.AddKeyValue(std::string(1, name), TCIMValue(1));
            }
            EXPECT_EQ(20u, large.GetKeyCount());
        }
        TCIMReference path(boost::shared_ptr<ICIMNamespace>{}, {});
        path.AddKeyValue("Id", TCIMValue(round));
        EXPECT_EQ(".Id=" + std::to_string(round), path.GetPath());
        EXPECT_EQ("", path.GetNamespaceName());
        EXPECT_EQ("", path.GetHost());
        EXPECT_EQ(nullptr, path.GetClass());
        // A reference can be nested twelve deep: the depth starts anew too.
        for (int depth = 0; depth < 12; ++depth) {
            path = Disk({{"Id", TCIMValue(path)}});
        }
    }
}

}  // namespace
}  // namespace NORVZEL20
