#pragma once

namespace NORVZEL20 {

/// What the user of a load can do about an error, for programs that have options for it.
enum class EAdvice : unsigned char {
    kNone,
    kGiveDeclaration,         ///< TLoadOptions::schema may give the declaration that is missing
    kGiveOrInferDeclaration,  ///< likewise, and TLoadOptions::infersClasses may too
    kLetBadValuesPass,        ///< another choice for TLoadOptions::badValues
    kKeepBadValuesAsText,     ///< TLoadOptions::badValues as text
    kLeaveFileOut,            ///< the document is no inventory in this form, and may be one in another
    kPlaceIncludedFile        ///< a file that a document includes has to be in one of the folders given for such files
};

}  // namespace NORVZEL20
