#pragma once

#include <string>

#include "client/baseline/TEntryScanner.h"

namespace NORVZEL20 {

/// Takes a value, or several with " / " between them, and returns it as ValueIdentity writes it: with single blanks, and numbers
/// and booleans in the spelling that they have there. Errors: TClientError for what is no value, also a number out of the range of
/// its type.
std::string TakeValue(TEntryScanner& scanner);

/// Takes a number of instances. Errors: TClientError for anything else.
std::string TakeCount(TEntryScanner& scanner);

}  // namespace NORVZEL20
