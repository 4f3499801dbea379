#pragma once

#include <string>

#include "client/baseline/TEntryScanner.h"

namespace NORVZEL20 {

/// Takes a value, or several with " / " between them, and returns it as ValueIdentity writes it: with single blanks, and numbers,
/// booleans and datetimes in the spelling that they have there. Errors: TClientError for what is no value, also a number out of the
/// range of its type and a datetime that is none.
std::string TakeValue(TEntryScanner& scanner);

/// The same for the reference, which has one value.
std::string TakeSingleValue(TEntryScanner& scanner);

/// Takes a number of instances that share a key, without zeros in front. Errors: TClientError for anything else and for less than
/// two.
std::string TakeCount(TEntryScanner& scanner);

}  // namespace NORVZEL20
