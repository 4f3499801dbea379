#pragma once

#include <nlohmann/json.hpp>
#include <string>

#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// A value in JSON: numbers exactly, booleans, null and arrays as such; text, datetimes, references (path text) and embedded
/// objects (CIM-XML) as strings; reals that JSON has no number for as "NaN", "INF" and "-INF".
nlohmann::ordered_json JsonOf(const TCIMValue& value);

/// The document's text: two blanks of indentation, or one line where `indented` is false. Bytes that are no UTF-8 become U+FFFD.
std::string WriteJson(const nlohmann::ordered_json& document, bool indented);

}  // namespace NORVZEL20
