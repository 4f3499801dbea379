// Two keys of one type are equal by value if and only if their texts in a path are equal.

#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <cmath>
#include <limits>

#include "embedded/value/TEmbeddedObject.h"
#include "tests/embedded/value/DateTimeOf.h"
#include "tests/embedded/value/ValuePrinter.h"

namespace NORVZEL20 {
namespace {

using TType = TCIMValue::TCIMType;

std::string TextOfKey(const TCIMValue& key)
{
    std::string text;
    key.AppendKeyText(text);
    return text;
}

TCIMValue Moment(const char* text)
{
    return TCIMValue(DateTimeOf(text));
}

TCIMValue PathTo(const char* text)
{
    return TCIMValue(TCIMReference::Parse(text));
}

/// A reference to Event.When, a datetime.
TCIMValue EventAt(const char* when)
{
    TCIMReference path;
    path.SetClassName("Event");
    path.AddKeyValue("When", Moment(when));
    return TCIMValue(path);
}

TCIMValue ListOf(const std::vector<TCIMValue>& elements)
{
    return TCIMValue(elements.front().GetType(), static_cast<unsigned int>(elements.size()), elements);
}

TEmbeddedObject::TProperty Member(const char* name, const TCIMValue& value, const char* origin = "")
{
    TEmbeddedObject::TProperty property;
    property.name = name;
    property.value = value;
    property.classOrigin = origin;
    return property;
}

TCIMValue Embedded(const char* className, const std::vector<TEmbeddedObject::TProperty>& properties, bool isClass = false)
{
    const auto object = boost::make_shared<TEmbeddedObject>(className, isClass);
    for (const TEmbeddedObject::TProperty& property : properties) {
        object->AddProperty(property);
    }
    return TCIMValue(boost::shared_ptr<const TEmbeddedObject>(object));
}

/// A class with a method, both with a qualifier. The parameters are named in this order.
TCIMValue MethodOf(const char* className, const char* qualifier, const std::vector<const char*>& parameters)
{
    TEmbeddedObject::TMethod method{"Start", TType::kUint32, "", false, {}, {{qualifier, TCIMValue(true)}}};
    for (const char* const name : parameters) {
        method.parameters.push_back({name, TType::kArrayString, "", 0, {}});
    }
    const auto object = boost::make_shared<TEmbeddedObject>(className, true);
    object->SetSuperClassName("CIM_Base");
    object->AddQualifier({qualifier, TCIMValue("1")});
    object->AddMethod(method);
    return TCIMValue(boost::shared_ptr<const TEmbeddedObject>(object));
}

using TRows = std::vector<std::vector<TCIMValue>>;

TRows GetTextRows()
{
    return {
        {TCIMValue(), TCIMValue::Null(TType::kString), TCIMValue::Null(TType::kDateTime)},
        {TCIMValue("a"), TCIMValue(std::string("a"))},
        {TCIMValue("A")},
        {TCIMValue("")},
        {TCIMValue("NULL")},
        {TCIMValue("a text of more than thirteen bytes"), TCIMValue("a text of more than thirteen bytes")},
        {TCIMValue("\"")},
        {TCIMValue("\\\"")},
        {TCIMValue("20240229110000.000000+000")},
        {TCIMValue("20240229120000.000000+060")},
        {TCIMValue(true), TCIMValue(true)},
        {TCIMValue(false)},
        {TCIMValue(u'x'), TCIMValue(u'x')},
        {TCIMValue(u'X')},
        {TCIMValue(u'\0')},
        {TCIMValue(u'\xD800')},
        {TCIMValue(u'\xFFFD')},
    };
}

TRows GetNumberRows()
{
    const double nan = std::numeric_limits<double>::quiet_NaN();
    const float narrowNan = std::numeric_limits<float>::quiet_NaN();
    const double infinity = std::numeric_limits<double>::infinity();
    return {
        {TCIMValue(static_cast<unsigned char>(255)), TCIMValue(static_cast<unsigned char>(255))},
        {TCIMValue(static_cast<unsigned char>(0))},
        {TCIMValue(static_cast<signed char>(-128)), TCIMValue(static_cast<signed char>(-128))},
        {TCIMValue(static_cast<signed char>(127))},
        {TCIMValue(static_cast<unsigned short>(65535)), TCIMValue(static_cast<unsigned short>(65535))},
        {TCIMValue(static_cast<unsigned short>(1))},
        {TCIMValue(static_cast<short>(-32768)), TCIMValue(static_cast<short>(-32768))},
        {TCIMValue(static_cast<short>(1))},
        {TCIMValue(~0u), TCIMValue(~0u)},
        {TCIMValue(1u)},
        {TCIMValue(-1), TCIMValue(-1)},
        {TCIMValue(1)},
        {TCIMValue(~0ul), TCIMValue(~0ul)},
        {TCIMValue(1ul)},
        {TCIMValue(-1l), TCIMValue(-1l)},
        {TCIMValue(1l)},
        {TCIMValue(0.0f), TCIMValue(-0.0f)},
        {TCIMValue(narrowNan), TCIMValue(-narrowNan)},
        {TCIMValue(0.1f), TCIMValue(0.1f)},
        {TCIMValue(std::nextafterf(0.1f, 1.0f))},
        {TCIMValue(0.0), TCIMValue(-0.0)},
        {TCIMValue(nan), TCIMValue(-nan)},
        {TCIMValue(infinity), TCIMValue(infinity)},
        {TCIMValue(-infinity)},
        {TCIMValue(0.1), TCIMValue(0.1)},
        {TCIMValue(std::nextafter(0.1, 1.0))},
    };
}

TRows GetMomentRows()
{
    return {
        {Moment("20240229120000.000000+060"), Moment("20240229110000.000000+000"), Moment("20240229033000.000000-450")},
        {Moment("20240229120000.000000+000"), Moment("20240229120000.000000-000"), Moment("20240301000000.000000+720")},
        {Moment("20240229120000.000001+000")},
        {Moment("20240229120000.00000*+000")},
        {Moment("2024022912****.******+060"), Moment("2024022911****.******+000"), Moment("2024022910****.******-060")},
        {Moment("2024022912****.******+090"), Moment("2024022911****.******+030"), Moment("2024022910****.******-030")},
        {Moment("2024022910****.******+000")},
        {Moment("20240229******.******+060"), Moment("20240229******.******+060")},
        {Moment("20240229******.******+000"), Moment("20240229******.******-000")},
        {Moment("20240229******.******+800"), Moment("20240228******.******-640")},
        {Moment("**************.******+060")},
        {Moment("**************.******+000")},
        {Moment("202402**003000.000000+060")},
        {Moment("00000101000000.000000+060"), Moment("00000101010000.000000+120")},
        {Moment("99991231233000.000000-060"), Moment("99991231223000.000000-120")},
        {Moment("19691231235959.999999+000"), Moment("19700101005959.999999+060")},
        {Moment("00000001000000.000000:000"), Moment("00000001000000.000000:000")},
        {Moment("00000001000000.00000*:000")},
        {Moment("********000000.000000:000")},
        {Moment("00000000000000.000000:000")},
    };
}

TRows GetPathRows()
{
    return {
        {PathTo("Disk.Id=\"sda\",Bay=1"), PathTo("/Disk.Bay=1,Id=\"sda\""), PathTo("Disk.Bay=1.0,Id=\"sda\"")},
        {PathTo("root/cimv2:Disk.Bay=1,Id=\"sda\""), PathTo("/ROOT/CIMv2:Disk.Bay=1,Id=\"sda\"")},
        {PathTo("//web01/root/cimv2:Disk.Id=\"sda\""), PathTo("//WEB01/Root/cimv2:Disk.Id=\"sda\"")},
        {PathTo("Disk.Id=\"SDA\"")},
        {PathTo("Disk"), PathTo("Disk=@")},
        {PathTo("Part.On=\"root/a:Disk.Id=1\"")},
        {EventAt("20240229120000.000000+060"), EventAt("20240229110000.000000+000")},
        {EventAt("20240229120000.000000+000")},
    };
}

TRows GetObjectRows()
{
    return {
        {Embedded("Setting", {Member("Size", TCIMValue(1)), Member("Name", TCIMValue("a"))}),
         Embedded("SETTING", {Member("name", TCIMValue("a"), "Base"), Member("SIZE", TCIMValue(1))}),
         Embedded("Setting", {Member("Name", TCIMValue("a")), Member("Gone", TCIMValue()), Member("Size", TCIMValue(1))})},
        {Embedded("Setting", {Member("Size", TCIMValue(1u)), Member("Name", TCIMValue("a"))})},
        {Embedded("Setting", {Member("Size", TCIMValue(1))})},
        {Embedded("Setting", {Member("Size", TCIMValue(1))}, true)},
        {Embedded("Setting", {})},
        {Embedded("Setting", {Member("A", TCIMValue("<VALUE>&\"")), Member("B", TCIMValue("\x01"))})},
        {Embedded("Setting", {Member("A", TCIMValue("<VALUE>&\"")), Member("B", TCIMValue("\x02"))})},
        {Embedded("Setting", {Member("A", TCIMValue("x</VALUE></PROPERTY><PROPERTY NAME=\"b\" TYPE=\"string\"><VALUE>y"))})},
        {Embedded("Setting", {Member("A", TCIMValue("x")), Member("B", TCIMValue("y"))})},
    };
}

TRows GetNestedObjectRows()
{
    return {
        {Embedded("Setting", {Member("At", Moment("20240229120000.000000+060")), Member("Load", TCIMValue(-0.0))}),
         Embedded("Setting", {Member("Load", TCIMValue(0.0)), Member("At", Moment("20240229110000.000000+000"))})},
        {Embedded("Setting", {Member("In", Embedded("Inner", {Member("P", TCIMValue(1)), Member("Q", TCIMValue(2))}))}),
         Embedded("Setting", {Member("In", Embedded("INNER", {Member("q", TCIMValue(2)), Member("p", TCIMValue(1))}))})},
        {Embedded("Setting", {Member("In", TCIMValue("<INSTANCE CLASSNAME=\"inner\"></INSTANCE>"))})},
        {Embedded("Setting", {Member("In", Embedded("Inner", {}))})},
        {Embedded("Setting", {Member("Of", PathTo("ROOT/a:Disk.Id=1"))}),
         Embedded("Setting", {Member("OF", PathTo("root/A:Disk.Id=1"))})},
        {Embedded("Setting", {Member("L", ListOf({TCIMValue("a"), TCIMValue("b")}))})},
        {Embedded("Setting", {Member("L", ListOf({TCIMValue("b"), TCIMValue("a")}))})},
        {Embedded("Setting", {Member("L", ListOf({TCIMValue("a</VALUE><VALUE>b")}))})},
        {Embedded("Setting", {Member("S", TCIMValue::Null(TType::kUint8))}, true)},
        {MethodOf("C", "Version", {"P", "Q"}), MethodOf("c", "VERSION", {"p", "q"})},
        {MethodOf("C", "Version", {"Q", "P"})},
    };
}

/// Keys that are equal in each row, written in different ways, and that differ from those of all other rows.
TRows GetRows()
{
    TRows rows;
    for (const TRows& some :
         {GetTextRows(), GetNumberRows(), GetMomentRows(), GetPathRows(), GetObjectRows(), GetNestedObjectRows()}) {
        rows.insert(rows.end(), some.begin(), some.end());
    }
    return rows;
}

TEST(KeyIdentityTest, KeysAreEqualByValueIfAndOnlyIfTheirTextsAre)
{
    const auto rows = GetRows();
    for (std::size_t i = 0; i < rows.size(); ++i) {
        for (const TCIMValue& a : rows[i]) {
            for (std::size_t k = 0; k < rows.size(); ++k) {
                for (const TCIMValue& b : rows[k]) {
                    EXPECT_EQ(i == k, a == b) << TextOfKey(a) << "\n" << TextOfKey(b);
                    EXPECT_EQ(i == k, a.IsSameKey(b)) << TextOfKey(a) << "\n" << TextOfKey(b);
                    // A path does not show the type, so only texts of one type must differ.
                    const bool haveOneType = a.GetType() == b.GetType() && !a.IsNull() && !b.IsNull();
                    EXPECT_TRUE(i == k ? TextOfKey(a) == TextOfKey(b) : !haveOneType || TextOfKey(a) != TextOfKey(b))
                        << TextOfKey(a) << "\n"
                        << TextOfKey(b);
                    EXPECT_TRUE(i != k || (a.KeyHash() == b.KeyHash() && a.Hash() == b.Hash())) << TextOfKey(a);
                }
            }
        }
    }
}

TEST(KeyIdentityTest, TheTextOfAKeyReadBackIsTheSame)
{
    for (const auto& row : GetRows()) {
        for (const TCIMValue& key : row) {
            TCIMReference path;
            path.SetClassName("C");
            path.AddKeyValue("K", key);
            EXPECT_EQ(path.GetPath(), TCIMReference::Parse(path.GetPath()).GetPath());
            EXPECT_EQ(path.GetPath(), TCIMReference::Parse("/" + path.GetPath()).GetPath());
        }
    }
}

TEST(KeyIdentityTest, EachTypeHasItsCanonicalText)
{
    const std::pair<TCIMValue, const char*> cases[] = {
        {TCIMValue("say \"a\\b\""), R"("say \"a\\b\"")"},
        {TCIMValue(-0.0), "0"},
        {TCIMValue(0.1f), "0.1"},
        {TCIMValue(-std::numeric_limits<double>::quiet_NaN()), "NaN"},
        {TCIMValue(1e300), "1e+300"},
        {TCIMValue(u'\''), R"('\'')"},
        {Moment("20240229120000.000000+060"), "\"20240229110000.000000+000\""},
        {Moment("20240229003000.000000+090"), "\"20240228230000.000000+000\""},
        {Moment("2024022912****.******+060"), "\"2024022911****.******+000\""},
        {Moment("2024022912****.******+090"), "\"2024022911****.******+030\""},
        {Moment("20240229******.******+060"), "\"20240229******.******+060\""},
        {Moment("202402**123000.00****-120"), "\"202402**143000.00****+000\""},
        {Moment("00000101000000.000000+060"), "\"00000101000000.000000+060\""},
        {Moment("99991231233000.000000-060"), "\"99991231235900.000000-031\""},
        {Moment("00000007000000.000000:000"), "\"00000007000000.000000:000\""},
        {PathTo("//WEB01/ROOT/cimv2:Disk.Id=\"SDA\""), R"("//web01/root/cimv2:Disk.Id=\"SDA\"")"},
        {EventAt("20240229120000.000000+060"), R"("Event.When=\"20240229110000.000000+000\"")"},
        {Embedded("Setting", {Member("Size", TCIMValue(1)), Member("Name", TCIMValue("a<b")), Member("N", TCIMValue())}),
         R"("<INSTANCE CLASSNAME=\"setting\"><PROPERTY NAME=\"name\" TYPE=\"string\"><VALUE>a&lt;b</VALUE></PROPERTY>)"
         R"(<PROPERTY NAME=\"size\" TYPE=\"sint32\"><VALUE>1</VALUE></PROPERTY></INSTANCE>")"},
        {MethodOf("C", "Version", {"P"}),
         R"("<CLASS NAME=\"c\" SUPERCLASS=\"cim_base\"><QUALIFIER NAME=\"version\" TYPE=\"string\" FLAVOR=\"3\"><VALUE>1</VALUE></QUALIFIER>)"
         R"(<METHOD NAME=\"start\" TYPE=\"uint32\"><QUALIFIER NAME=\"version\" TYPE=\"boolean\" FLAVOR=\"3\"><VALUE>TRUE</VALUE></QUALIFIER>)"
         R"(<PARAMETER NAME=\"p\" TYPE=\"string[]\"></PARAMETER></METHOD></CLASS>")"},
        {ListOf({TCIMValue("a"), TCIMValue(), TCIMValue("b\"")}), R"({"a", NULL, "b\""})"},
    };
    for (const auto& [key, text] : cases) {
        EXPECT_EQ(text, TextOfKey(key));
    }
}

TEST(KeyIdentityTest, ArraysAndBagsAreTheSameKeyIfTheirTextsAre)
{
    const TCIMValue ab = ListOf({Moment("20240229120000.000000+060"), Moment("20240101000000.000000+000")});
    const TCIMValue ba = ListOf({Moment("20240101000000.000000+000"), Moment("20240229110000.000000+000")});
    EXPECT_FALSE(ab.IsSameKey(ba));
    EXPECT_TRUE(ab.AsBag().IsSameKey(ba.AsBag()));
    EXPECT_EQ(ab.AsBag().KeyHash(), ba.AsBag().KeyHash());
    EXPECT_TRUE(ab.IsSameKey(ListOf({Moment("20240229110000.000000+000"), Moment("20240101010000.000000+060")})));
    EXPECT_TRUE(Embedded("C", {Member("L", ab.AsBag())}).IsSameKey(Embedded("C", {Member("L", ba.AsBag())})));
}

TEST(KeyIdentityTest, TextThatReadsLikeAnObjectIsTheSameKeyThoughNotEqual)
{
    const TCIMValue object = Embedded("Setting", {Member("Size", TCIMValue(1))});
    const TCIMValue text(object.GetEmbeddedObject()->GetKeyText());
    EXPECT_NE(object, text);
    EXPECT_TRUE(object.IsSameKey(text));
    EXPECT_TRUE(text.IsSameKey(object));
    EXPECT_EQ(object.KeyHash(), text.KeyHash());
    EXPECT_FALSE(object.IsSameKey(TCIMValue("Setting")));
    EXPECT_FALSE(object.IsSameKey(TCIMValue::Null(TType::kString)));
}

TEST(KeyIdentityTest, ArraysOfObjectsAndOfTextsThatReadLikeThemAreTheSameKeyThoughNotEqual)
{
    const TCIMValue object = Embedded("Setting", {Member("Size", TCIMValue(1))});
    const TCIMValue objects = ListOf({object});
    const TCIMValue texts = ListOf({TCIMValue(object.GetEmbeddedObject()->GetKeyText())});
    EXPECT_NE(objects, texts);
    EXPECT_TRUE(objects.IsSameKey(texts));
    EXPECT_EQ(TextOfKey(objects), TextOfKey(texts));
    EXPECT_EQ(objects.KeyHash(), texts.KeyHash());
}

TEST(KeyIdentityTest, ABagIsTheSameKeyAsTheSortedArrayThoughEqualToAnyOrder)
{
    const TCIMValue sorted = ListOf({TCIMValue("a"), TCIMValue("b")});
    const TCIMValue turned = ListOf({TCIMValue("b"), TCIMValue("a")});
    for (const auto& [bag, same, other] :
         {std::tuple(turned.AsBag(), sorted, turned),
          std::tuple(Embedded("C", {Member("L", turned.AsBag())}), Embedded("C", {Member("L", sorted)}),
                     Embedded("C", {Member("L", turned)}))}) {
        EXPECT_EQ(TextOfKey(bag), TextOfKey(same));
        EXPECT_TRUE(bag.IsSameKey(same));
        EXPECT_EQ(bag, other);
        EXPECT_NE(TextOfKey(bag), TextOfKey(other));
        EXPECT_FALSE(bag.IsSameKey(other));
    }
}

TEST(KeyIdentityTest, NullsOfAllTypesAreTheSameKey)
{
    EXPECT_TRUE(TCIMValue().IsSameKey(TCIMValue::Null(TType::kUint8)));
    EXPECT_TRUE(TCIMValue::Null(TType::kString).IsSameKey(TCIMValue::Null(TType::kUint8)));
    EXPECT_EQ(TCIMValue::Null(TType::kString).KeyHash(), TCIMValue::Null(TType::kUint8).KeyHash());
    EXPECT_FALSE(TCIMValue::Null(TType::kString).IsSameKey(TCIMValue("NULL")));
}

TEST(KeyIdentityTest, ValuesForPeopleStayAsTheyWereWritten)
{
    TCIMReference path = TCIMReference::Parse("//WEB01/root/PG_InterOp:Event");
    path.AddKeyValue("At", Moment("20240229120000.000000+060"));
    path.AddKeyValue("Of", Embedded("Setting", {}));
    path.AddKeyValue("On", PathTo("ROOT:Disk.Id=1"));
    EXPECT_EQ(
        R"(//web01/root/pg_interop:Event.At="20240229110000.000000+000",Of="<INSTANCE CLASSNAME=\"setting\"></INSTANCE>",On="root:Disk.Id=1")",
        path.GetPath());
    const std::string written =
        R"(//WEB01/root/PG_InterOp:Event.At="20240229120000.000000+060",Of="<INSTANCE CLASSNAME=\"Setting\"></INSTANCE>",On="ROOT:Disk.Id=1")";
    EXPECT_EQ(written, path.ToText());
    EXPECT_EQ(written, TCIMValue(path).ToText());
    EXPECT_EQ("20240229120000.000000+060", Moment("20240229120000.000000+060").ToText());
    EXPECT_EQ("", TCIMReference().ToText());
}

}  // namespace
}  // namespace NORVZEL20
