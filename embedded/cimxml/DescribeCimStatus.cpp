#include "embedded/cimxml/DescribeCimStatus.h"

#include <array>

#include "embedded/load/MessageText.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

/// What a status that a server answers with is called (DSP0200). Numbers without a name were never assigned.
constexpr std::array<const char*, 29> kStatusNames = {"",
                                                      "CIM_ERR_FAILED",
                                                      "CIM_ERR_ACCESS_DENIED",
                                                      "CIM_ERR_INVALID_NAMESPACE",
                                                      "CIM_ERR_INVALID_PARAMETER",
                                                      "CIM_ERR_INVALID_CLASS",
                                                      "CIM_ERR_NOT_FOUND",
                                                      "CIM_ERR_NOT_SUPPORTED",
                                                      "CIM_ERR_CLASS_HAS_CHILDREN",
                                                      "CIM_ERR_CLASS_HAS_INSTANCES",
                                                      "CIM_ERR_INVALID_SUPERCLASS",
                                                      "CIM_ERR_ALREADY_EXISTS",
                                                      "CIM_ERR_NO_SUCH_PROPERTY",
                                                      "CIM_ERR_TYPE_MISMATCH",
                                                      "CIM_ERR_QUERY_LANGUAGE_NOT_SUPPORTED",
                                                      "CIM_ERR_INVALID_QUERY",
                                                      "CIM_ERR_METHOD_NOT_AVAILABLE",
                                                      "CIM_ERR_METHOD_NOT_FOUND",
                                                      "",
                                                      "",
                                                      "CIM_ERR_NAMESPACE_NOT_EMPTY",
                                                      "CIM_ERR_INVALID_ENUMERATION_CONTEXT",
                                                      "CIM_ERR_INVALID_OPERATION_TIMEOUT",
                                                      "CIM_ERR_PULL_HAS_BEEN_ABANDONED",
                                                      "CIM_ERR_PULL_CANNOT_BE_ABANDONED",
                                                      "CIM_ERR_FILTERED_ENUMERATION_NOT_SUPPORTED",
                                                      "CIM_ERR_CONTINUATION_ON_ERROR_NOT_SUPPORTED",
                                                      "CIM_ERR_SERVER_LIMITS_EXCEEDED",
                                                      "CIM_ERR_SERVER_IS_SHUTTING_DOWN"};

}  // namespace

std::string DescribeCimStatus(const std::string& code)
{
    TCIMValue number;
    const bool isNumber = TValueText::Parse(TCIMValue::TCIMType::kUint32, code, number);
    if (!isNumber || number.GetUnsigned() >= kStatusNames.size() || *kStatusNames[number.GetUnsigned()] == '\0') {
        return "status " + Quote(code);
    }
    return std::string(kStatusNames[number.GetUnsigned()]) + " (" + code + ")";
}

}  // namespace NORVZEL20
