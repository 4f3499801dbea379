#pragma once

#include <string>

#include "host/Export.h"

namespace NORVZEL20 {

/// A status number of the host.
class CIMDELTA_EXPORT TZELStatusCode {
  public:
    enum EStatusCode : int {
        kSuccess = 0,
        kNotOffered = 1,  ///< this implementation does not have the operation
        kInitializationFailed = 3,
        kOutOfMemory = 4,
        kInvalidParameter = 5,  ///< an argument that this operation never accepts
        kParseError = 9,        ///< a document or a text that does not follow its grammar
        kFileError = 11,        ///< a file that cannot be opened or read
        kAlreadyExists = 12,    ///< there is already a class or qualifier of that name, or an instance with those keys
        kTypeMismatch = 13,     ///< a value that does not fit the type, or an accessor of another type
        kKeyMissing = 14,       ///< an instance without a value for one of its keys
        kNotFound = 15,         ///< no class, property, qualifier, method or instance of that name or with those keys
        kInvalidQuery = 16,     ///< a query that does not follow the grammar, or a test that the types do not allow
        kQueryLanguageUnknown = 17,
        kNamespaceGone = 18,  ///< the namespace that an object belongs to has been destroyed
        kClassInUse = 19,     ///< a class with subclasses or instances cannot be removed
        kNotSupported = 31,   ///< the operation cannot be done with this object
        kSchemaMismatch = 37,
        kMissingParameter = 38
    };

    TZELStatusCode(EStatusCode status) noexcept : fStatus(status) {}

    EStatusCode GetStatus() const noexcept { return fStatus; }
    bool operator==(const TZELStatusCode& other) const noexcept { return fStatus == other.fStatus; }
    bool operator!=(const TZELStatusCode& other) const noexcept { return fStatus != other.fStatus; }

    /// The host's text for the status. Valid until the process ends. All numbers without a name above share one text.
    /// Allocates nothing: the texts are made when the library is loaded.
    const std::string& TranslateStatusCode() const;

  private:
    EStatusCode fStatus;
};

}  // namespace NORVZEL20
