#include "client/report/TJsonDocument.h"

#include <gtest/gtest.h>

namespace NORVZEL20 {
namespace {

using TJson = nlohmann::ordered_json;

/// An object that is written member by member, and beside it the same object as a whole.
class JsonDocumentTest : public testing::Test {
  protected:
    void Add(const std::string& name, const TJson& value)
    {
        fDocument.Add(name, value);
        fWhole[name] = value;
    }

    void AddList(const std::string& name, const std::vector<TJson>& elements)
    {
        fDocument.StartList(name);
        for (const TJson& element : elements) {
            fDocument.AddElement(element);
        }
        fDocument.EndList();
        fWhole[name] = TJson(elements);
    }

    void ExpectTheWhole()
    {
        fDocument.End();
        EXPECT_EQ(fWhole.dump(2) + "\n", fWritten);
    }

    std::string fWritten;
    TJsonDocument fDocument{[this](std::string_view piece) { fWritten += piece; }};
    TJson fWhole = TJson::object();
};

TEST_F(JsonDocumentTest, IsTheTextOfTheWhole)
{
    const TJson nested = {{"a", {1, 2, {{"b", "line\nend"}}}}, {"empty", TJson::array()}, {"none", TJson::object()}};
    Add("text", "\"quoted\"\n");
    Add("number", 1);
    Add("nested", nested);
    AddList("list", {nested, 5, "text", TJson::array(), nested});
    Add("behind", nullptr);
    ExpectTheWhole();
}

TEST_F(JsonDocumentTest, AListMayComeFirstAndLastAndBeEmpty)
{
    AddList("first", {});
    AddList("middle", {TJson::object()});
    AddList("last", {});
    ExpectTheWhole();
}

TEST_F(JsonDocumentTest, WhatIsCompleteIsWrittenAtOnce)
{
    Add("a", 1);
    EXPECT_EQ("{\n  \"a\": 1", fWritten);
    fDocument.StartList("b");
    fDocument.AddElement(2);
    EXPECT_EQ("{\n  \"a\": 1,\n  \"b\": [\n    2", fWritten);
}

TEST(CompactJsonDocument, IsOneLine)
{
    std::string written;
    TJsonDocument document([&written](std::string_view piece) { written += piece; }, false);
    document.Add("a", TJson{{"b", 1}, {"c", {1, 2}}});
    document.StartList("empty");
    document.EndList();
    document.StartList("list");
    document.AddElement("x");
    document.AddElement(TJson{{"y", nullptr}});
    document.EndList();
    document.End();
    EXPECT_EQ("{\"a\":{\"b\":1,\"c\":[1,2]},\"empty\":[],\"list\":[\"x\",{\"y\":null}]}\n", written);
}

}  // namespace
}  // namespace NORVZEL20
