// How the values of a query compare.
//
// A query's literals have few types, so types need not be equal: all numbers compare with each other, and a text literal compares
// with char16, datetimes and references too. Numbers are compared as long double, which holds every CIM number exactly. A result
// is unknown if a value does not say enough: a null, an embedded object, a datetime with asterisks.

#include "embedded/query/TQueryComparison.h"

#include "embedded/value/TTypeKind.h"
#include "host/TCIMDateTime.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

namespace {

using TType = TCIMValue::TCIMType;

/// Whether values of the type can be written as a text literal.
bool IsTextual(TType type)
{
    return type == TType::kString || type == TType::kChar16 || type == TType::kDateTime || type == TType::kReference;
}

/// Exact for every number, because the significand of a long double has at least 64 bits here.
long double GetNumber(const TCIMValue& value)
{
    if (TTypeKind::IsReal(value.GetType())) {
        return value.GetReal();
    }
    if (TTypeKind::IsSigned(value.GetType())) {
        return static_cast<long double>(value.GetSigned());
    }
    return static_cast<long double>(value.GetUnsigned());
}

template <class T>
TQueryComparison::EResult Order(const T& a, const T& b)
{
    if (a < b) {
        return TQueryComparison::kLess;
    }
    if (b < a) {
        return TQueryComparison::kGreater;
    }
    return a == b ? TQueryComparison::kEqual : TQueryComparison::kUnordered;
}

bool ReadDateTime(const TCIMValue& value, TCIMDateTime& time)
{
    if (value.GetType() == TType::kDateTime) {
        time = value.GetDateTime();
        return time.GetUnknown() == 0;
    }
    return TCIMDateTime::Parse(value.GetString(), time) && time.GetUnknown() == 0;
}

TQueryComparison::EResult CompareDateTimes(const TCIMValue& a, const TCIMValue& b)
{
    TCIMDateTime first;
    TCIMDateTime second;
    if (!ReadDateTime(a, first) || !ReadDateTime(b, second)) {
        return TQueryComparison::kUnknown;
    }
    return Order(first, second);
}

bool HoldsObject(const TCIMValue& value)
{
    return value.GetType() == TType::kString && value.GetEmbeddedObject();
}

}  // namespace

bool TQueryComparison::AreComparable(TCIMValue::TCIMType a, TCIMValue::TCIMType b)
{
    if (a.IsArray() || b.IsArray()) {
        return false;
    }
    // The literal NULL and a property of another class have no type; they compare with everything, as unknown.
    if (a == TType::kNone || b == TType::kNone || a == b) {
        return true;
    }
    const bool isText = a == TType::kString || b == TType::kString;
    return (TTypeKind::IsNumber(a) && TTypeKind::IsNumber(b)) || (isText && IsTextual(a) && IsTextual(b));
}

bool TQueryComparison::AreOrdered(TCIMValue::TCIMType a, TCIMValue::TCIMType b)
{
    const auto isUnordered = [](TType type) { return type == TType::kBoolean || type == TType::kReference; };
    return !isUnordered(a) && !isUnordered(b);
}

bool TQueryComparison::IsReadable(const TCIMValue& literal, TCIMValue::TCIMType type)
{
    if (literal.IsNull() || literal.GetType() != TType::kString || type != TType::kDateTime) {
        return true;
    }
    TCIMDateTime time;
    return TCIMDateTime::Parse(literal.GetString(), time);
}

TQueryComparison::EResult TQueryComparison::Compare(const TCIMValue& a, const TCIMValue& b)
{
    // A value may be text that does not fit its declared type.
    if (a.IsNull() || b.IsNull() || HoldsObject(a) || HoldsObject(b) || !AreComparable(a.GetType(), b.GetType())) {
        return kUnknown;
    }
    if (TTypeKind::IsNumber(a.GetType())) {
        return Order(GetNumber(a), GetNumber(b));
    }
    if (a.GetType() == TType::kBoolean) {
        return a.GetBoolean() == b.GetBoolean() ? kEqual : kUnordered;
    }
    if (a.GetType() == TType::kDateTime || b.GetType() == TType::kDateTime) {
        return CompareDateTimes(a, b);
    }
    if (a.GetType() == TType::kString && b.GetType() == TType::kString) {
        return Order(a.GetString(), b.GetString());
    }
    // What is left is char16 and references, beside each other or beside a text literal.
    return Order(a.ToText(), b.ToText());
}

}  // namespace NORVZEL20
