// Whatever values, keys and labels there are: what is written of them is read, and written again as it is.

#include <gtest/gtest.h>

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <iterator>
#include <limits>
#include <random>
#include <string>
#include <vector>

#include "client/baseline/EntryText.h"
#include "client/baseline/ReadBaseline.h"
#include "client/baseline/ValueIdentity.h"
#include "client/process/TClientError.h"
#include "client/text/DisplayText.h"
#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {
namespace {

using TType = TCIMValue::TCIMType;

/// Makes values and texts of pieces that mean something in a baseline.
class TMaker {
  public:
    explicit TMaker(unsigned seed) : fRandom(seed) {}

    std::size_t Below(std::size_t count) { return std::uniform_int_distribution<std::size_t>(0, count - 1)(fRandom); }

    std::string Text()
    {
        static const std::vector<std::string> fgPieces{"a",
                                                       "in",
                                                       " in ",
                                                       " -> ",
                                                       ", ",
                                                       ",",
                                                       "\"",
                                                       "'",
                                                       "\\",
                                                       "\n",
                                                       "\t",
                                                       "#",
                                                       " # ",
                                                       " / ",
                                                       " x2",
                                                       "{",
                                                       "}",
                                                       "NULL",
                                                       "\x01",
                                                       "\x7f",
                                                       "\xff",
                                                       "\xc3\xa9",
                                                       "\xc2\xa0",
                                                       "\xe2\x80\xae",
                                                       "=",
                                                       ".",
                                                       ":",
                                                       "P: ",
                                                       std::string(1, '\0'),
                                                       "uint16 5",
                                                       "\\n",
                                                       "\\x1b"};
        std::string text;
        for (std::size_t count = Below(4); count > 0; --count) {
            text += fgPieces[Below(fgPieces.size())];
        }
        return text;
    }

    TCIMValue Single(TType type)
    {
        switch (type) {
        case TType::kBoolean:
            return Below(2) == 0;
        case TType::kUint8:
            return static_cast<unsigned char>(Below(256));
        case TType::kSint8:
            return static_cast<signed char>(-128 + static_cast<int>(Below(256)));
        case TType::kUint16:
            return static_cast<unsigned short>(Below(65536));
        case TType::kSint16:
            return static_cast<short>(-32768 + static_cast<int>(Below(65536)));
        case TType::kUint32:
            return std::numeric_limits<unsigned int>::max() - static_cast<unsigned int>(Below(3));
        case TType::kSint32:
            return std::numeric_limits<int>::min() + static_cast<int>(Below(3));
        case TType::kUint64:
            return std::numeric_limits<unsigned long>::max() - Below(3);
        case TType::kSint64:
            return std::numeric_limits<long>::min() + static_cast<long>(Below(3));
        case TType::kReal32:
            return static_cast<float>(Real());
        case TType::kReal64:
            return Real();
        case TType::kChar16:
            return static_cast<char16_t>(Below(2) == 0 ? Below(256) : Below(65536));
        case TType::kDateTime:
            return Converted(Below(2) == 0 ? "20261122104400.000000+060" : "00000003000000.000000:000", type);
        case TType::kReference:
            return Converted(Below(2) == 0 ? "root/cimv2:Disk.Id=\"a\\\"b\"" : "Disk.Id=\"in\",B=2", type);
        default:
            return Below(4) == 0 ? Embedded() : TCIMValue(Text());
        }
    }

    TCIMValue Any()
    {
        const auto type = static_cast<TType::ECIMType>(1 + Below(TType::kReference));
        if (Below(3) > 0) {
            return Single(type);
        }
        std::vector<TCIMValue> elements(Below(4));
        for (TCIMValue& element : elements) {
            element = Below(4) == 0 ? TCIMValue::Null(type) : Single(type);
        }
        return TCIMValue(TType(type).GetArrayType(), static_cast<unsigned int>(elements.size()), elements);
    }

  private:
    double Real()
    {
        const double some[] = {0.0,
                               -0.0,
                               0.1,
                               -1.5e300,
                               1e-7,
                               1e21,
                               std::numeric_limits<double>::infinity(),
                               -std::numeric_limits<double>::infinity(),
                               std::numeric_limits<double>::quiet_NaN()};
        return some[Below(std::size(some))];
    }

    static TCIMValue Converted(const char* text, TType type)
    {
        TCIMValue value;
        EXPECT_TRUE(TValueText::Convert(TCIMValue(text), type, value)) << text;
        return value;
    }

    TCIMValue Embedded()
    {
        const auto object = boost::make_shared<TEmbeddedObject>("Cfg");
        TEmbeddedObject::TProperty property;
        property.name = "P";
        property.value = TCIMValue(Text());
        object->AddProperty(property);
        return TCIMValue(boost::shared_ptr<const TEmbeddedObject>(object));
    }

    std::mt19937 fRandom;
};

TAcceptedDifference MakeEntry(TMaker& maker)
{
    TAcceptedDifference entry{static_cast<TDifference::EKind>(maker.Below(3)), {}, {}, {}};
    std::string key;
    maker.Single(static_cast<TType::ECIMType>(1 + maker.Below(TType::kReference))).AppendKeyText(key);
    const std::string instances[] = {"in", "Disk", "Disk.Id=" + EscapeForDisplay(key)};
    entry.instance = FieldText(instances[maker.Below(std::size(instances))]);
    const auto value = [&maker] {
        std::string text = ValueIdentity(maker.Any(), maker.Below(2) == 0);
        return maker.Below(4) == 0 ? text + " x2 / " + ValueIdentity(maker.Any(), false) : text;
    };
    if (entry.kind == TDifference::kChanged) {
        entry.values.push_back({"P", ValueIdentity(maker.Any(), maker.Below(2) == 0), value()});
    } else if (entry.kind == TDifference::kOnlyInOthers) {
        for (const char* const property : {"(instances)", "A", "in"}) {
            if (maker.Below(2) == 0) {
                entry.values.push_back({property, std::string(), *property == '(' ? "2" : value()});
            }
        }
    }
    for (std::size_t count = 1 + maker.Below(3); count > 0; --count) {
        entry.inventories.push_back(EscapeForDisplay("w" + maker.Text()));
        entry.inventories.push_back(EscapeForDisplay(maker.Text()));
    }
    std::sort(entry.inventories.begin(), entry.inventories.end());
    entry.inventories.erase(std::unique(entry.inventories.begin(), entry.inventories.end()), entry.inventories.end());
    return entry;
}

TEST(WrittenEntriesTest, WhatIsWrittenIsReadAndWrittenAgainAsItIs)
{
    for (unsigned seed = 0; seed < 20000; ++seed) {
        TMaker maker(seed);
        TBaseline made;
        made.Add(MakeEntry(maker));
        const std::string written = made.ToText();
        try {
            const TBaseline read = ParseBaseline(written, "base.txt");
            ASSERT_EQ(written, read.ToText()) << seed;
            ASSERT_EQ(made.GetEntries().front().inventories, read.GetEntries().front().inventories) << seed;
            ASSERT_TRUE(made.GetEntries().front().values == read.GetEntries().front().values) << seed;
        } catch (const TClientError& error) {
            FAIL() << error.what() << "\n" << written;
        }
    }
}

}  // namespace
}  // namespace NORVZEL20
