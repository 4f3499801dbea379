#pragma once

#include <string>

namespace NORVZEL20 {

/// A status number of the host.
class TZELStatusCode {
  public:
    enum EStatusCode : int {
        kSuccess = 0,
        kNotOffered = 1,  ///< the operation is not offered here, as distinct from being refused
        kInitializationFailed = 3,
        kOutOfMemory = 4,
        kInvalidParameter = 5,  ///< an argument that no call of this operation can accept
        kParseError = 9,        ///< a document or a text that does not follow its grammar
        kFileError = 11,        ///< a file that cannot be opened or read
        kAlreadyExists = 12,    ///< a class, qualifier or instance of that name or with those keys is there already
        kTypeMismatch = 13,
        kKeyMissing = 14,  ///< an instance without a value for one of its keys
        kNotFound = 15,
        kInvalidQuery = 16,
        kQueryLanguageUnknown = 17,
        kNamespaceGone = 18,  ///< the namespace that an object belongs to has been destroyed
        kClassInUse = 19,     ///< a class with subclasses or instances cannot be removed
        kNotSupported = 31,
        kSchemaMismatch = 37,
        kMissingParameter = 38
    };

    TZELStatusCode(EStatusCode status) noexcept : fStatus(status) {}

    EStatusCode GetStatus() const noexcept { return fStatus; }
    bool operator==(const TZELStatusCode& other) const noexcept { return fStatus == other.fStatus; }
    bool operator!=(const TZELStatusCode& other) const noexcept { return fStatus != other.fStatus; }

    /// The host's text for the status, valid until the process ends; one text for every number not named above.
    const std::string& TranslateStatusCode() const;

  private:
    EStatusCode fStatus;
};

}  // namespace NORVZEL20
