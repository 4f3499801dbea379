#include "embedded/value/TEmbeddedObject.h"

#include <gtest/gtest.h>

#include "tests/embedded/value/ValuePrinter.h"

namespace NORVZEL20 {
namespace {

using TObject = TEmbeddedObject;
using TType = TCIMValue::TCIMType;

TObject::TProperty Property(const char* name, const TCIMValue& value)
{
    TObject::TProperty property;
    property.name = name;
    property.value = value;
    return property;
}

TObject Object(std::initializer_list<TObject::TProperty> properties, bool isClass = false)
{
    TObject object("Setting", isClass);
    for (const auto& property : properties) {
        object.AddProperty(property);
    }
    return object;
}

void ExpectEqual(const TObject& a, const TObject& b)
{
    EXPECT_TRUE(a == b) << a.ToText() << "\n" << b.ToText();
    EXPECT_TRUE(b == a);
    EXPECT_EQ(a.Hash(), b.Hash());
}

TEST(EmbeddedObjectTest, LetterCaseOfNamesAndOrderDoNotCount)
{
    ExpectEqual(TObject("Setting"), TObject("SETTING"));
    ExpectEqual(Object({Property("A", TCIMValue(1)), Property("B", TCIMValue("x"))}),
                Object({Property("b", TCIMValue("x")), Property("a", TCIMValue(1))}));
}

TEST(EmbeddedObjectTest, ValuesTypesAndNamesCount)
{
    const TObject object = Object({Property("A", TCIMValue(1))});
    EXPECT_NE(object, Object({Property("A", TCIMValue(2))}));
    EXPECT_NE(object, Object({Property("A", TCIMValue(1u))}));
    EXPECT_NE(object, Object({Property("B", TCIMValue(1))}));
    EXPECT_NE(object, Object({}));
    EXPECT_NE(object, Object({Property("A", TCIMValue(1)), Property("B", TCIMValue(1))}));
    EXPECT_NE(TObject("Setting"), TObject("Settings"));
    EXPECT_NE(TObject("Setting"), TObject("Setting", true));
}

TEST(EmbeddedObjectTest, APropertyThatIsNullEqualsOneThatIsMissingInAnInstance)
{
    const TCIMValue null = TCIMValue::Null(TType::kUint8);
    ExpectEqual(Object({Property("A", null)}), Object({}));
    EXPECT_NE(Object({Property("A", null)}, true), Object({}, true));
    EXPECT_NE(Object({Property("A", null)}, true), Object({Property("A", TCIMValue::Null(TType::kUint16))}, true));
    ExpectEqual(Object({Property("A", null)}, true), Object({Property("a", null)}, true));
}

TEST(EmbeddedObjectTest, BagsWithinAnObjectCompareAsBags)
{
    const TCIMValue ab(TType::kString, 2, {TCIMValue("a"), TCIMValue("b")});
    const TCIMValue ba(TType::kString, 2, {TCIMValue("b"), TCIMValue("a")});
    ExpectEqual(Object({Property("A", ab.AsBag())}), Object({Property("A", ba.AsBag())}));
    EXPECT_NE(Object({Property("A", ab)}), Object({Property("A", ba)}));
}

TEST(EmbeddedObjectTest, QualifiersCount)
{
    TObject plain("C", true);
    TObject qualified("C", true);
    qualified.AddQualifier({"Version", TCIMValue("1"), ICIMQualifierDecl::kFlavorDefault, false});
    TObject other("C", true);
    other.AddQualifier({"VERSION", TCIMValue("1"), ICIMQualifierDecl::kFlavorDefault, true});
    EXPECT_NE(plain, qualified);
    EXPECT_EQ(qualified, other) << "where it came from does not count";
    TObject flavored("C", true);
    flavored.AddQualifier({"Version", TCIMValue("1"), ICIMQualifierDecl::kFlavorNone, false});
    EXPECT_NE(qualified, flavored);
}

TEST(EmbeddedObjectTest, SuperclassAndMethodsCount)
{
    TObject cls("C", true);
    cls.SetSuperClassName("B");
    EXPECT_NE(cls, TObject("C", true));
    TObject method("C", true);
    method.AddMethod({"M", TType::kUint32, "", false, {{"P", TType::kString, "", 0, {}}, {"Q", TType::kString, "", 0, {}}}, {}});
    TObject swapped("C", true);
    swapped.AddMethod({"M", TType::kUint32, "", false, {{"Q", TType::kString, "", 0, {}}, {"P", TType::kString, "", 0, {}}}, {}});
    EXPECT_NE(method, TObject("C", true));
    EXPECT_NE(method, swapped) << "parameters stand in an order";
    EXPECT_EQ(method, TObject(method));
}

TEST(EmbeddedObjectTest, PropertiesAreFoundInAnySpelling)
{
    const TObject object = Object({Property("Size", TCIMValue(1))});
    EXPECT_EQ("Size", object.FindProperty("SIZE")->name);
    EXPECT_EQ(nullptr, object.FindProperty("Sizes"));
}

}  // namespace
}  // namespace NORVZEL20
