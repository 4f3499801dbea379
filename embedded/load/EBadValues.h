#pragma once

namespace NORVZEL20 {

/// What becomes of a value whose text does not fit its type: a number out of range, a datetime with asterisks in wrong places, an
/// empty text for a number.
enum class EBadValues : unsigned char {
    kRefuse,  ///< the load fails, when it has counted how many there are
    kNull,    ///< it is NULL; a key still has to have a value
    kText     ///< it is kept as a string beside the declared type, an array as one of strings
};

}  // namespace NORVZEL20
