#include "host/TZELStatusCode.h"

namespace NORVZEL20 {

namespace {

struct TStatusText {
    int status;
    std::string text;
};

// Never destroyed: the text of an exception may be read while the process ends. The last entry is for every other number.
const TStatusText* GetTexts()
{
    static const auto* const fgTexts = new TStatusText[]{
        {TZELStatusCode::kSuccess, "Success"},
        {TZELStatusCode::kNotOffered, "Not offered"},
        {TZELStatusCode::kInitializationFailed, "Initialization failed"},
        {TZELStatusCode::kOutOfMemory, "Out of memory"},
        {TZELStatusCode::kInvalidParameter, "Invalid parameter"},
        {TZELStatusCode::kParseError, "Parse error"},
        {TZELStatusCode::kFileError, "File error"},
        {TZELStatusCode::kAlreadyExists, "Already exists"},
        {TZELStatusCode::kTypeMismatch, "Type mismatch"},
        {TZELStatusCode::kKeyMissing, "Key without a value"},
        {TZELStatusCode::kNotFound, "Not found"},
        {TZELStatusCode::kInvalidQuery, "Invalid query"},
        {TZELStatusCode::kQueryLanguageUnknown, "Unknown query language"},
        {TZELStatusCode::kNamespaceGone, "Namespace is gone"},
        {TZELStatusCode::kClassInUse, "Class in use"},
        {TZELStatusCode::kNotSupported, "Not supported"},
        {TZELStatusCode::kSchemaMismatch, "Schema mismatch"},
        {TZELStatusCode::kMissingParameter, "Missing parameter"},
        {-1, "Unknown status"},
    };
    return fgTexts;
}

// The texts are made while the library is loaded: an exception is asked for its text when there may be no memory left.
[[maybe_unused]] const bool kMade = (GetTexts(), true);

}  // namespace

const std::string& TZELStatusCode::TranslateStatusCode() const
{
    const TStatusText* entry = GetTexts();
    while (entry->status != -1 && entry->status != static_cast<int>(fStatus)) {
        ++entry;
    }
    return entry->text;
}

}  // namespace NORVZEL20
