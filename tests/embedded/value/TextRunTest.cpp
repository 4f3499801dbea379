#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "embedded/value/TSharedText.h"
#include "embedded/value/TTextRun.h"
#include "embedded/value/TValueAccess.h"

namespace NORVZEL20 {
namespace {

TCIMValue Add(TTextRun& run, const std::string& text)
{
    const std::uint16_t offset = run.Append(text);
    return TValueAccess::FromRun(run, offset, static_cast<std::uint16_t>(text.size()));
}

TEST(TextRun, TextsLieOneBehindTheOther)
{
    const auto run = TTextRun::Create();
    EXPECT_EQ(0u, run->Append("one"));
    EXPECT_EQ(3u, run->Append("three"));
    EXPECT_EQ(8u, run->Append(""));
    EXPECT_EQ("one", run->GetText(0, 3));
    EXPECT_EQ("three", run->GetText(3, 5));
}

TEST(TextRun, TheLastTextFillsTheRunToItsEnd)
{
    const auto run = TTextRun::Create();
    const std::string text(TTextRun::kLongestText, 'x');
    std::vector<TCIMValue> values;
    while (run->HasRoomFor(text.size())) {
        values.push_back(Add(*run, text));
    }
    std::size_t rest = 0;
    while (run->HasRoomFor(rest + 1)) {
        ++rest;
    }
    EXPECT_EQ(TTextRun::kSize - sizeof(TTextRun), values.size() * text.size() + rest);
    values.push_back(Add(*run, std::string(rest, 'y')));
    EXPECT_TRUE(run->HasRoomFor(0));
    EXPECT_FALSE(run->HasRoomFor(1));
    EXPECT_EQ(text, values.front().GetString());
    EXPECT_EQ(std::string(rest, 'y'), values.back().GetString());
}

TEST(TextRun, ASmallRunIsFullSooner)
{
    const auto run = TTextRun::Create(100);
    EXPECT_EQ(100u, run->GetSize());
    const std::size_t room = 100 - sizeof(TTextRun);
    EXPECT_TRUE(run->HasRoomFor(room));
    EXPECT_FALSE(run->HasRoomFor(room + 1));
    const std::string text(room, 'x');
    EXPECT_EQ(text, Add(*run, text).GetString());
    EXPECT_FALSE(run->HasRoomFor(1));
}

TEST(TextRun, AValueInARunIsLikeAnyOther)
{
    const auto run = TTextRun::Create();
    Add(*run, "something before");
    const std::string text = "a \"text\" in a run";
    const TCIMValue value = Add(*run, text);
    for (const TCIMValue& other : {TCIMValue(text), Add(*run, text), TValueAccess::FromSharedText(TSharedText::Create(text))}) {
        EXPECT_TRUE(value == other);
        EXPECT_TRUE(other == value);
        EXPECT_TRUE(value.IsSameKey(other));
        EXPECT_EQ(other.Hash(), value.Hash());
        EXPECT_EQ(other.KeyHash(), value.KeyHash());
    }
    for (const TCIMValue& other : {TCIMValue("a \"text\" in a rut"), Add(*run, "a \"text\" in a ru"), TCIMValue("short"),
                                   TCIMValue(5), TCIMValue::Null(TCIMValue::TCIMType::kString)}) {
        EXPECT_FALSE(value == other);
        EXPECT_FALSE(other == value);
    }
    EXPECT_FALSE(value.IsNull());
    EXPECT_EQ(TCIMValue::TCIMType::kString, value.GetType());
    EXPECT_EQ(text, value.GetString());
    EXPECT_EQ(text, value.ToText());
    EXPECT_EQ(nullptr, value.GetEmbeddedObject());
    std::string key;
    value.AppendKeyText(key);
    EXPECT_EQ("\"a \\\"text\\\" in a run\"", key);
}

/// What a run and its values keep alive is one count.
TEST(TextRun, EachCopyOfAValueUsesTheRunUntilItGoes)
{
    const auto run = TTextRun::Create();
    EXPECT_TRUE(run->IsUnique());
    {
        TCIMValue value = Add(*run, "a text in a run");
        EXPECT_FALSE(run->IsUnique());
        TCIMValue copy(value);
        value = TCIMValue(5);
        EXPECT_FALSE(run->IsUnique());
        const TCIMValue moved(std::move(copy));
        EXPECT_FALSE(run->IsUnique());
        EXPECT_EQ("a text in a run", moved.GetString());
    }
    EXPECT_TRUE(run->IsUnique());
}

}  // namespace
}  // namespace NORVZEL20
