#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <cmath>
#include <limits>

#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TValueAccess.h"
#include "tests/embedded/value/DateTimeOf.h"
#include "tests/embedded/value/ValuePrinter.h"
#include "tests/support/StatusOf.h"

namespace NORVZEL20 {
namespace {

using TType = TCIMValue::TCIMType;

constexpr int kTypeMismatch = TZELStatusCode::kTypeMismatch;

TCIMReference Disk(const char* id)
{
    TCIMReference path;
    path.SetClassName("Disk");
    path.AddKeyValue("Id", TCIMValue(id));
    return path;
}

boost::shared_ptr<const TEmbeddedObject> Setting(int size)
{
    auto object = boost::make_shared<TEmbeddedObject>("Setting");
    object->AddProperty({"Size", TCIMValue(size), "", 0, "", false, {}});
    return object;
}

TCIMValue Array(const std::vector<TCIMValue>& elements)
{
    return TCIMValue(elements.front().GetType(), static_cast<unsigned int>(elements.size()), elements);
}

TCIMValue Numbers(std::initializer_list<int> numbers)
{
    return TCIMValue(TType(TType::kSint32), static_cast<unsigned int>(numbers.size()),
                     std::vector<TCIMValue>(numbers.begin(), numbers.end()));
}

/// One value of each type and way of being held, no two equal.
std::vector<TCIMValue> OneOfEachKind()
{
    return {TCIMValue(true),
            TCIMValue(static_cast<unsigned char>(7)),
            TCIMValue(static_cast<signed char>(7)),
            TCIMValue(static_cast<unsigned short>(7)),
            TCIMValue(static_cast<short>(7)),
            TCIMValue(7u),
            TCIMValue(7),
            TCIMValue(7ul),
            TCIMValue(7l),
            TCIMValue(7.0f),
            TCIMValue(7.0),
            TCIMValue(u'7'),
            TCIMValue("7"),
            TCIMValue("more text than fits inside of a value"),
            TCIMValue(DateTimeOf("20240101120000.000000+000")),
            TCIMValue(DateTimeOf("00000007000000.000000:000")),
            TCIMValue(Disk("7")),
            TCIMValue(TCIMReference()),
            TCIMValue(Setting(7)),
            Numbers({7}),
            Array({TCIMValue("7")})};
}

TEST(ValueTest, ANewValueIsNullWithoutAType)
{
    const TCIMValue value;
    EXPECT_TRUE(value.IsNull());
    EXPECT_EQ(TType::kNone, value.GetType());
    EXPECT_EQ("NULL", value.ToText());
}

TEST(ValueTest, EachConstructorGivesItsType)
{
    std::string types;
    for (const TCIMValue& value : OneOfEachKind()) {
        EXPECT_FALSE(value.IsNull());
        types += std::to_string(static_cast<int>(value.GetType())) + " ";
    }
    EXPECT_EQ("1 2 3 4 5 6 7 8 9 10 11 12 13 13 14 14 15 15 13 23 29 ", types);
    EXPECT_EQ(TType::kUint64, TCIMValue(7ull).GetType());
    EXPECT_EQ(TType::kSint64, TCIMValue(7ll).GetType());
}

TEST(ValueTest, CodesOfArraysAreThoseOfTheirElementsPlus16)
{
    EXPECT_EQ(20, static_cast<int>(TType(TType::kUint16).GetArrayType()));
    EXPECT_EQ(TType::kArrayUint16, TType(TType::kArrayUint16).GetArrayType());
    EXPECT_EQ(TType::kUint16, TType(TType::kArrayUint16).GetElementType());
    EXPECT_EQ(TType::kReference, TType(TType::kReference).GetElementType());
    EXPECT_FALSE(TType(TType::kReference).IsArray());
    EXPECT_TRUE(TType(TType::kArrayBoolean).IsArray());
}

TEST(ValueTest, ValuesOfDifferentKindsNeverAreEqual)
{
    const std::vector<TCIMValue> values = OneOfEachKind();
    for (std::size_t i = 0; i < values.size(); ++i) {
        for (std::size_t k = 0; k < values.size(); ++k) {
            EXPECT_EQ(i == k, values[i] == values[k]) << i << " " << k;
        }
        EXPECT_FALSE(values[i] == TCIMValue()) << i;
        EXPECT_FALSE(TCIMValue() == values[i]) << i;
    }
}

TEST(ValueTest, CopiesAreEqualAndOutliveTheirOrigin)
{
    std::vector<TCIMValue> copies;
    {
        const std::vector<TCIMValue> values = OneOfEachKind();
        copies = values;
    }
    EXPECT_EQ(copies, OneOfEachKind());
    for (TCIMValue& value : copies) {
        const std::string text = value.ToText();
        TCIMValue& same = value;
        value = same;
        EXPECT_EQ(text, value.ToText());
        TCIMValue moved(std::move(value));
        EXPECT_EQ(text, moved.ToText());
        value = std::move(moved);
        EXPECT_EQ(text, value.ToText());
    }
}

TEST(ValueTest, NullsOfAllTypesAreEqual)
{
    EXPECT_EQ(TCIMValue(), TCIMValue::Null(TType::kString));
    EXPECT_EQ(TCIMValue::Null(TType::kArrayString), TCIMValue::Null(TType::kUint8));
    EXPECT_EQ(TType::kString, TCIMValue::Null(TType::kString).GetType());
    EXPECT_NE(TCIMValue(""), TCIMValue::Null(TType::kString));
    EXPECT_NE(Numbers({}), TCIMValue::Null(TType::kArraySint32));
    EXPECT_TRUE(TCIMValue(boost::shared_ptr<const TEmbeddedObject>()).IsNull());
}

TEST(ValueTest, TextIsComparedByteForByteAtEveryLength)
{
    for (std::size_t length = 0; length < 40; ++length) {
        const std::string text(length, 'a');
        EXPECT_EQ(text, TCIMValue(text).GetString());
        EXPECT_EQ(TCIMValue(text), TCIMValue(text));
        EXPECT_NE(TCIMValue(text), TCIMValue(text + " "));
        EXPECT_NE(TCIMValue(text + "A"), TCIMValue(text + "a"));
    }
    const std::string withNul("a\0b", 3);
    EXPECT_EQ(withNul, TCIMValue(withNul).GetString());
    EXPECT_EQ("a", TCIMValue("a\0b").GetString());
}

TEST(ValueTest, SharedTextEqualsTextOfItsOwn)
{
    for (const char* const text : {"", "thirteen chrs", "fourteen chars", "rather more than fourteen chars"}) {
        const TCIMValue shared = TValueAccess::FromSharedText(TSharedText::Create(text));
        EXPECT_EQ(shared, TCIMValue(text));
        EXPECT_EQ(shared.Hash(), TCIMValue(text).Hash());
        EXPECT_EQ(text, shared.GetString());
    }
}

TEST(ValueTest, RealsAreComparedByValueWithNanEqualToNan)
{
    const double nan = std::numeric_limits<double>::quiet_NaN();
    EXPECT_EQ(TCIMValue(nan), TCIMValue(-nan));
    EXPECT_NE(TCIMValue(nan), TCIMValue(0.0));
    EXPECT_NE(TCIMValue(0.0), TCIMValue(nan));
    EXPECT_EQ(TCIMValue(0.0), TCIMValue(-0.0));
    EXPECT_NE(TCIMValue(1.0), TCIMValue(std::nextafter(1.0, 2.0)));
    EXPECT_EQ(TCIMValue(0.1f).GetReal(), static_cast<double>(0.1f));
    EXPECT_EQ(TCIMValue(nan).Hash(), TCIMValue(-nan).Hash());
    EXPECT_EQ(TCIMValue(0.0).Hash(), TCIMValue(-0.0).Hash());
}

TEST(ValueTest, DatetimesAreComparedAsInstants)
{
    EXPECT_EQ(TCIMValue(DateTimeOf("20240101120000.000000+000")), TCIMValue(DateTimeOf("20240101130000.000000+060")));
    EXPECT_NE(TCIMValue(DateTimeOf("20240101120000.000000+000")), TCIMValue(DateTimeOf("20240101120000.000000+060")));
    EXPECT_EQ("20240101130000.000000+060", TCIMValue(DateTimeOf("20240101130000.000000+060")).GetDateTime().ToText());
    EXPECT_EQ("********000000.******:000", TCIMValue(DateTimeOf("********000000.******:000")).GetDateTime().ToText());
}

TEST(ValueTest, ReferencesAreComparedByPathText)
{
    EXPECT_EQ(TCIMValue(Disk("sda")), TCIMValue(Disk("sda")));
    EXPECT_NE(TCIMValue(Disk("sda")), TCIMValue(Disk("sdb")));
    TCIMReference path = Disk("sda");
    path.SetNamespaceName("root/cimv2");
    EXPECT_NE(TCIMValue(Disk("sda")), TCIMValue(path));
    EXPECT_EQ(TCIMValue(Disk("sda")).Hash(), TCIMValue(Disk("sda")).Hash());
}

TEST(ValueTest, AReferenceValueDoesNotShowLaterChangesOfThePath)
{
    TCIMReference path = Disk("sda");
    const TCIMValue value(path);
    path.AddKeyValue("Id", TCIMValue("sdb"));
    EXPECT_EQ("Disk.Id=\"sda\"", value.ToText());
    EXPECT_EQ("Disk.Id=\"sda\"", TCIMReference(value).GetPath());
}

TEST(ValueTest, EmbeddedObjectsAreComparedByStructure)
{
    EXPECT_EQ(TCIMValue(Setting(1)), TCIMValue(Setting(1)));
    EXPECT_NE(TCIMValue(Setting(1)), TCIMValue(Setting(2)));
    EXPECT_NE(TCIMValue(Setting(1)), TCIMValue(Setting(1)->ToText())) << "text is no object";
    EXPECT_NE(TCIMValue(Setting(1)->ToText()), TCIMValue(Setting(1)));
    EXPECT_EQ("Setting", TCIMValue(Setting(1)).GetEmbeddedObject()->GetClassName());
    EXPECT_EQ(nullptr, TCIMValue("text").GetEmbeddedObject());
    EXPECT_EQ(nullptr, TCIMValue::Null(TType::kString).GetEmbeddedObject());
}

TEST(ValueTest, ArraysAreComparedElementByElementInOrder)
{
    EXPECT_EQ(Numbers({1, 2}), Numbers({1, 2}));
    EXPECT_NE(Numbers({1, 2}), Numbers({2, 1}));
    EXPECT_NE(Numbers({1, 2}), Numbers({1}));
    EXPECT_NE(Numbers({1}), Numbers({1, 2}));
    EXPECT_NE(Numbers({1}), TCIMValue(1));
    EXPECT_EQ(Numbers({}), Numbers({}));
}

TEST(ValueTest, ABagOnTheLeftIsComparedAsAMultiset)
{
    EXPECT_TRUE(Numbers({1, 2, 2}).AsBag() == Numbers({2, 1, 2}));
    EXPECT_FALSE(Numbers({2, 1, 2}) == Numbers({1, 2, 2}).AsBag()) << "the mark of the right operand does not count";
    EXPECT_FALSE(Numbers({1, 2, 2}).AsBag() == Numbers({1, 1, 2}));
    EXPECT_FALSE(Numbers({1, 2}).AsBag() == Numbers({1, 2, 2}));
    EXPECT_TRUE(Array({TCIMValue("b"), TCIMValue::Null(TType::kString), TCIMValue("a")}).AsBag() ==
                Array({TCIMValue("a"), TCIMValue("b"), TCIMValue::Null(TType::kString)}));
    EXPECT_TRUE(Array({TCIMValue(Setting(1)), TCIMValue(Setting(2))}).AsBag() ==
                Array({TCIMValue(Setting(2)), TCIMValue(Setting(1))}));
}

TEST(ValueTest, ElementsOfABagThatHashAlikeAreStillToldApart)
{
    const TCIMValue nan(std::numeric_limits<double>::quiet_NaN());
    const TCIMValue tiny(1e-300);
    ASSERT_EQ(nan.Hash(), tiny.Hash());
    EXPECT_TRUE(Array({nan, tiny}).AsBag() == Array({tiny, nan}));
    EXPECT_FALSE(Array({nan, tiny}).AsBag() == Array({nan, nan}));
}

TEST(ValueTest, OnlyArraysBecomeBags)
{
    EXPECT_TRUE(Numbers({1}).AsBag().IsBag());
    EXPECT_FALSE(Numbers({1}).IsBag());
    EXPECT_FALSE(TCIMValue(1).AsBag().IsBag());
    EXPECT_FALSE(TCIMValue::Null(TType::kArrayUint8).AsBag().IsBag());
    EXPECT_EQ("{2, 1}", Numbers({2, 1}).AsBag().ToText());
}

TEST(ValueTest, AnArrayTakesTheFirstElementsOfItsType)
{
    const std::vector<TCIMValue> elements{TCIMValue(static_cast<unsigned short>(1)), TCIMValue(static_cast<unsigned short>(2))};
    EXPECT_EQ("{1, 2}", TCIMValue(TType::kArrayUint16, 2, elements).ToText());
    EXPECT_EQ(TType::kArrayUint16, TCIMValue(TType::kUint16, 2, elements).GetType());
    EXPECT_EQ("{1}", TCIMValue(TType::kArrayUint16, 1, elements).ToText());
    EXPECT_EQ("{1, 2}", TCIMValue(TType::kArrayUint16, 9, elements).ToText());
    EXPECT_EQ("{}", TCIMValue(TType::kArrayUint16, 0, elements).ToText());
    EXPECT_FALSE(TCIMValue(TType::kArrayUint16, 0, elements).IsNull());
    EXPECT_EQ(TType::kUint16, TCIMValue(TType::kArrayUint16, 1, {TCIMValue()}).GetElements()[0].GetType());
}

TEST(ValueTest, AnArrayRefusesElementsOfAnotherType)
{
    const std::vector<TCIMValue> elements{TCIMValue(static_cast<unsigned short>(1)), TCIMValue("2")};
    EXPECT_EQ(kTypeMismatch, StatusOf([&] { TCIMValue(TType::kArrayUint16, 2, elements); }));
    EXPECT_EQ(0, StatusOf([&] { TCIMValue(TType::kArrayUint16, 1, elements); }));
    EXPECT_EQ(kTypeMismatch, StatusOf([&] { TCIMValue(TType::kNone, 0, elements); }));
    EXPECT_EQ(kTypeMismatch, StatusOf([&] { TCIMValue(TType::kArraySint32, 1, {Numbers({1})}); }));
}

TEST(ValueTest, EveryIntegerUpTo65535ConvertsToUnsignedShort)
{
    EXPECT_EQ(2, static_cast<unsigned short>(TCIMValue(static_cast<unsigned short>(2))));
    EXPECT_EQ(255, static_cast<unsigned short>(TCIMValue(static_cast<unsigned char>(255))));
    EXPECT_EQ(65535, static_cast<unsigned short>(TCIMValue(65535)));
    EXPECT_EQ(65535, static_cast<unsigned short>(TCIMValue(65535ul)));
    EXPECT_EQ(127, static_cast<unsigned short>(TCIMValue(static_cast<signed char>(127))));
}

TEST(ValueTest, NothingElseConvertsToUnsignedShort)
{
    std::vector<TCIMValue> refused{TCIMValue(),         TCIMValue::Null(TType::kUint16),
                                   TCIMValue(-1),       TCIMValue(65536),
                                   TCIMValue(~0ul),     TCIMValue(true),
                                   TCIMValue(1.0),      TCIMValue("1"),
                                   TCIMValue(u'1'),     Numbers({1}),
                                   TCIMValue(Disk("1"))};
    for (const TCIMValue& value : refused) {
        EXPECT_EQ(kTypeMismatch, StatusOf([&] { static_cast<void>(static_cast<unsigned short>(value)); })) << value.ToText();
    }
}

TEST(ValueTest, OnlyReferencesConvertToPaths)
{
    EXPECT_EQ("", TCIMReference(TCIMValue(TCIMReference())).GetPath());
    for (const TCIMValue& value :
         {TCIMValue(), TCIMValue::Null(TType::kReference), TCIMValue("Disk"), Array({TCIMValue(Disk("1"))})}) {
        EXPECT_EQ(kTypeMismatch, StatusOf([&] { static_cast<void>(static_cast<TCIMReference>(value)); })) << value.ToText();
    }
}

TEST(ValueTest, EachAccessorAcceptsItsOwnTypesAlone)
{
    std::string accepted;
    for (const TCIMValue& value : OneOfEachKind()) {
        accepted += std::to_string(static_cast<int>(value.GetType()));
        accepted += StatusOf([&] { value.GetBoolean(); }) == 0 ? " boolean" : "";
        accepted += StatusOf([&] { value.GetUnsigned(); }) == 0 ? " unsigned" : "";
        accepted += StatusOf([&] { value.GetSigned(); }) == 0 ? " signed" : "";
        accepted += StatusOf([&] { value.GetReal(); }) == 0 ? " real" : "";
        accepted += StatusOf([&] { value.GetChar16(); }) == 0 ? " char16" : "";
        accepted += StatusOf([&] { value.GetString(); }) == 0 ? " string" : "";
        accepted += StatusOf([&] { value.GetDateTime(); }) == 0 ? " datetime" : "";
        accepted += StatusOf([&] { value.GetEmbeddedObject(); }) == 0 ? " object" : "";
        accepted += StatusOf([&] { value.GetElements(); }) == 0 ? " elements" : "";
        accepted += "\n";
    }
    EXPECT_EQ("1 boolean\n2 unsigned\n3 signed\n4 unsigned\n5 signed\n6 unsigned\n7 signed\n8 unsigned\n9 signed\n10 real\n"
              "11 real\n12 char16\n13 string object\n13 string object\n14 datetime\n14 datetime\n15\n15\n13 object\n"
              "23 elements\n29 elements\n",
              accepted);
}

TEST(ValueTest, NoAccessorAcceptsNull)
{
    EXPECT_EQ(kTypeMismatch, StatusOf([] { TCIMValue::Null(TType::kBoolean).GetBoolean(); }));
    EXPECT_EQ(kTypeMismatch, StatusOf([] { TCIMValue::Null(TType::kUint8).GetUnsigned(); }));
    EXPECT_EQ(kTypeMismatch, StatusOf([] { TCIMValue::Null(TType::kSint8).GetSigned(); }));
    EXPECT_EQ(kTypeMismatch, StatusOf([] { TCIMValue::Null(TType::kReal32).GetReal(); }));
    EXPECT_EQ(kTypeMismatch, StatusOf([] { TCIMValue::Null(TType::kChar16).GetChar16(); }));
    EXPECT_EQ(kTypeMismatch, StatusOf([] { TCIMValue::Null(TType::kString).GetString(); }));
    EXPECT_EQ(kTypeMismatch, StatusOf([] { TCIMValue::Null(TType::kDateTime).GetDateTime(); }));
    EXPECT_EQ(kTypeMismatch, StatusOf([] { TCIMValue::Null(TType::kArrayUint8).GetElements(); }));
}

TEST(ValueTest, NumbersKeepTheirExtremes)
{
    EXPECT_EQ("-128 255 -32768 65535 -2147483648 4294967295 -9223372036854775808 18446744073709551615",
              TCIMValue(static_cast<signed char>(-128)).ToText() + " " + TCIMValue(static_cast<unsigned char>(255)).ToText() + " " +
                  TCIMValue(static_cast<short>(-32768)).ToText() + " " + TCIMValue(static_cast<unsigned short>(65535)).ToText() +
                  " " + TCIMValue(std::numeric_limits<int>::min()).ToText() + " " + TCIMValue(~0u).ToText() + " " +
                  TCIMValue(std::numeric_limits<long>::min()).ToText() + " " + TCIMValue(~0ul).ToText());
    EXPECT_EQ(-1, TCIMValue(static_cast<signed char>(-1)).GetSigned());
}

TEST(ValueTest, TextIsForPeople)
{
    EXPECT_EQ("a\"b", TCIMValue("a\"b").ToText());
    EXPECT_EQ("TRUE", TCIMValue(true).ToText());
    EXPECT_EQ("0.1", TCIMValue(0.1f).ToText());
    EXPECT_EQ("1e+300", TCIMValue(1e300).ToText());
    EXPECT_EQ("-INF", TCIMValue(-std::numeric_limits<double>::infinity()).ToText());
    EXPECT_EQ("NaN", TCIMValue(std::numeric_limits<double>::quiet_NaN()).ToText());
    EXPECT_EQ("\xC3\xA4", TCIMValue(u'\u00E4').ToText());
    EXPECT_EQ("\xE2\x82\xAC", TCIMValue(u'\u20AC').ToText());
    EXPECT_EQ("{\"a\\\"b\", NULL}", Array({TCIMValue("a\"b"), TCIMValue()}).ToText());
    EXPECT_EQ("<INSTANCE CLASSNAME=\"Setting\"><PROPERTY NAME=\"Size\" TYPE=\"sint32\"><VALUE>1</VALUE></PROPERTY></INSTANCE>",
              TCIMValue(Setting(1)).ToText());
}

TEST(ValueTest, EqualValuesHashAlike)
{
    const std::vector<TCIMValue> values = OneOfEachKind();
    const std::vector<TCIMValue> again = OneOfEachKind();
    for (std::size_t i = 0; i < values.size(); ++i) {
        EXPECT_EQ(values[i].Hash(), again[i].Hash()) << i;
    }
    EXPECT_EQ(TCIMValue(DateTimeOf("20240101120000.000000+000")).Hash(), TCIMValue(DateTimeOf("20240101130000.000000+060")).Hash());
    EXPECT_NE(TCIMValue("a").Hash(), TCIMValue("b").Hash());
    EXPECT_NE(Numbers({1, 2}).Hash(), Numbers({2, 1}).Hash());
}

}  // namespace
}  // namespace NORVZEL20
