#include "client/text/TypeName.h"

namespace NORVZEL20 {

std::string TypeName(TCIMValue::TCIMType type)
{
    static const char* const names[] = {"none",   "boolean", "uint8",  "sint8",  "uint16", "sint16", "uint32",   "sint32",
                                        "uint64", "sint64",  "real32", "real64", "char16", "string", "datetime", "reference"};
    return std::string(names[type.GetElementType()]) + (type.IsArray() ? "[]" : "");
}

}  // namespace NORVZEL20
