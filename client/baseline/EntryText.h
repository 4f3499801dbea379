#pragma once

#include <string>

#include "client/comparison/TAcceptedDifference.h"

namespace NORVZEL20 {

/// The text as one field of an entry: as it is, or in quotes if it would look like a part of what stands around it.
std::string FieldText(const std::string& text);

/// "+", "-" or "~", with which an entry of that kind begins.
const char* SignOf(TDifference::EKind kind);

/// The line of an entry, without comments, reason and the end of the line; ParseEntry.cpp shows its parts.
std::string EntryText(const TAcceptedDifference& entry);

}  // namespace NORVZEL20
