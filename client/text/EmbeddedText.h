#pragma once

#include <string>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// A value as by DisplayValue, except that an embedded instance is shown by its properties: `Cfg {Name: "x", Speed: 100}`, in
/// ascending order of their names and without those that are null. Qualifiers and types do not show, so different instances may
/// have the same text. An embedded class is shown as by DisplayValue.
std::string DisplayContents(const TCIMValue& value);

/// The type of a value for people: "embedded object" for an embedded instance or class, "embedded object[]" for an array with at
/// least one, otherwise the name of the CIM type.
std::string DescribeContents(const TCIMValue& value);

/// Whether the value is an embedded instance or class, or an array with at least one.
bool HasEmbeddedObject(const TCIMValue& value);

}  // namespace NORVZEL20
