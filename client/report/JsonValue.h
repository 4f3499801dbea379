#pragma once

#include <nlohmann/json.hpp>
#include <string>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// A value in JSON. Null, booleans, arrays and numbers are what they are in JSON, 64-bit integers with all digits. Everything else
/// is a string: text, datetimes, references (as path text), embedded objects (as CIM-XML), and the reals "NaN", "INF" and "-INF".
nlohmann::ordered_json JsonOf(const TCIMValue& value);

/// What an embedded instance consists of: { "class": "Cfg", "properties": { "Speed": 100 } }, in ascending order of the names; for
/// an embedded class { "classDeclaration": "Cfg" }. An array has one of these for each element, or null for plain text. Null for
/// any other value.
nlohmann::ordered_json ContentsOf(const TCIMValue& value);

/// A value with its type: { "type": "uint32", "value": 5 }, and with "embedded", its ContentsOf, if it is an embedded object.
nlohmann::ordered_json JsonWithType(const TCIMValue& value);

/// Adds a list as a member, unless it is empty.
void AddJsonList(nlohmann::ordered_json& json, const char* name, nlohmann::ordered_json list);

/// The document's text with a line end: indented by two blanks, or in one line. Bytes that are not UTF-8 become U+FFFD.
std::string WriteJson(const nlohmann::ordered_json& document, bool indented);

}  // namespace NORVZEL20
