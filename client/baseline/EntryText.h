#pragma once

#include <string>
#include <string_view>

#include "client/comparison/TAcceptedDifference.h"

namespace NORVZEL20 {

/// The text as one field of an entry: as it is, or in quotes if it could not be told from what stands around it.
std::string FieldText(const std::string& text);

/// "+", "-" or "~", with which an entry of that kind begins.
const char* SignOf(TDifference::EKind kind);

/// What an entry says of one value: `Version: "5.1" -> "5.2"`.
std::string EntryValueText(const TAcceptedDifference::TValue& value);

/// The line of an entry, without comments, reason and the end of the line. ParseEntry draws it.
std::string EntryText(const TAcceptedDifference& entry);

}  // namespace NORVZEL20
