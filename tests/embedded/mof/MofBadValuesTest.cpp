#include <gtest/gtest.h>

#include <string>

#include "embedded/load/TLoadSession.h"
#include "embedded/mof/TMofDocuments.h"
#include "embedded/value/TEmbeddedObject.h"
#include "tests/embedded/mof/TMofLoading.h"

namespace NORVZEL20 {
namespace {

/// Texts in properties that are declared to hold objects, which begin like MOF and are none.
class MofBadValuesTest : public testing::Test {
  protected:
    MofBadValuesTest()
    {
        fLoading.Load("Qualifier Key : boolean = false, Scope(property, reference), Flavor(DisableOverride, ToSubclass);\n"
                      "Qualifier EmbeddedObject : boolean = false, Scope(property);\n"
                      "class Box { [Key] string Id; [EmbeddedObject] string E; [EmbeddedObject] string Es[]; Box REF Next; };\n"
                      "class Link { [Key] Box REF From; };\n");
    }

    /// The message of a load that fails; else one line for each property with such values.
    std::string Load(EBadValues choice, const std::string& document)
    {
        TLoadOptions options;
        options.badValues = choice;
        try {
            TLoadSession session(fLoading.GetNamespace(), "doc.mof", options);
            TMofDocuments(session).ReadMemory(document.data(), document.size(), "doc.mof");
            std::string lines;
            for (const TBadProperty& bad : session.Commit().badProperties) {
                lines += bad.className + "." + bad.property + " " + std::to_string(bad.count) + ": " + bad.text + " is no " +
                         bad.type + ", " + std::to_string(bad.line) + ":" + std::to_string(bad.column) + ", " + bad.instance + "\n";
            }
            return lines;
        } catch (const TPopulateError& error) {
            fAdvice = error.GetAdvice();
            return error.what();
        }
    }

    std::string ValueOf(const std::string& id, const std::string& property) const
    {
        return fLoading.ValueOf("Box.Id=\"" + id + "\"", property);
    }

    TMofLoading fLoading;
    EAdvice fAdvice = EAdvice::kNone;
};

const std::string kLawsuit = "instance of Box { Id = \"1\"; E = \"class action lawsuit\"; };\n";

TEST_F(MofBadValuesTest, TheRefusalSaysThatTheyMayPass)
{
    EXPECT_EQ("doc.mof:1:29: in an embedded object: found \"lawsuit\", expected { in front of the features of the class; "
              "correct it, or have such values loaded as NULL or as text",
              Load(EBadValues::kRefuse, kLawsuit));
    EXPECT_EQ(EAdvice::kLetBadValuesPass, fAdvice);
}

TEST_F(MofBadValuesTest, TheyBecomeNull)
{
    EXPECT_EQ("Box.E 1: class action lawsuit is no class or instance, 1:29, Box.Id=\"1\"\n", Load(EBadValues::kNull, kLawsuit));
    EXPECT_EQ("NULL", ValueOf("1", "E"));
}

TEST_F(MofBadValuesTest, TheyAreKeptAsText)
{
    EXPECT_EQ(
        "Box.E 1: class action lawsuit is no class or instance, 1:29, Box.Id=\"1\"\n"
        "Box.Es 1: {\"class N { };\", \"class action lawsuit\"} is no class or instance, 2:29, Box.Id=\"2\"\n",
        Load(EBadValues::kText, kLawsuit + "instance of Box { Id = \"2\"; Es = {\"class N { };\", \"class action lawsuit\"}; };"));
    EXPECT_EQ("class action lawsuit", ValueOf("1", "E"));
    EXPECT_EQ("{\"class N { };\", \"class action lawsuit\"}", ValueOf("2", "Es"));
}

TEST_F(MofBadValuesTest, WithinAnObjectTheyAreThatObjects)
{
    const std::string document =
        "instance of Box { Id = \"1\"; E = instance of Box { Id = \"i\"; E = \"class action lawsuit\"; }; };";
    EXPECT_EQ("Box.E 1: class action lawsuit is no class or instance, 1:29, Box.Id=\"1\"\n", Load(EBadValues::kText, document));
    const auto inner = [this] { return fLoading.RawValueOf("Box.Id=\"1\"", "E").GetEmbeddedObject(); };
    ASSERT_TRUE(inner());
    EXPECT_EQ("class action lawsuit", inner()->FindProperty("E")->value.ToText());
}

/// Each text is read at the depth of its property, and an alias in it is known to the next one.
TEST_F(MofBadValuesTest, WhatComesBehindThemIsReadAsIfTheyWereNotThere)
{
    std::string document = "instance of Box { Id = \"0\"; Es = {";
    document += "instance of Box { E = \"instance of oops\"; }";
    document += "}; };\ninstance of Link as $L { From = $B; };\ninstance of Box as $B { Id = \"b\"; };\n";
    for (int number = 1; number <= 40; ++number) {
        document += "instance of Box { Id = \"" + std::to_string(number) + "\"; E = \"instance of Box { Next = $None; };\"; };\n";
    }
    document += "instance of Box { Id = \"last\"; E = \"instance of Box { Id = \\\"deep\\\"; Next = $B; };\"; };\n";
    const std::string found = Load(EBadValues::kNull, document);
    EXPECT_EQ("Box.E 41: instance of oops is no class or instance", found.substr(0, found.find(", ")));
    ASSERT_TRUE(fLoading.RawValueOf("Box.Id=\"last\"", "E").GetEmbeddedObject());
    EXPECT_EQ("Box.Id=\"b\"",
              fLoading.RawValueOf("Box.Id=\"last\"", "E").GetEmbeddedObject()->FindProperty("Next")->value.ToText());
}

/// The keys of $A cannot be made.
TEST_F(MofBadValuesTest, AnAliasThatFailsLeavesOthersAlone)
{
    std::string document = "instance of Link as $A { From = 5; };\ninstance of Box as $B { Id = \"b\"; };\n";
    for (int number = 1; number <= 20; ++number) {
        document += "instance of Box { Id = \"" + std::to_string(number) + "\"; E = \"instance of Box { Next = $A; };\"; };\n";
    }
    document += "instance of Box { Id = \"last\"; E = \"instance of Box { Next = $B; };\"; };\n";
    const std::string found = Load(EBadValues::kText, document);
    EXPECT_NE(std::string::npos, found.find("Box.E 20: instance of Box { Next = $A; }; is no class or instance")) << found;
    EXPECT_EQ("instance of Box { Next = $A; };", ValueOf("20", "E"));
    EXPECT_TRUE(fLoading.RawValueOf("Box.Id=\"last\"", "E").GetEmbeddedObject());
}

}  // namespace
}  // namespace NORVZEL20
