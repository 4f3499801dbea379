#pragma once

#include "host/Export.h"

namespace NORVZEL20 {

/// The elements of CIM-XML (DSP0203) that a document to load may have.
class CIMDELTA_INTERNAL_EXPORT TCimXmlElement {
  public:
    enum EElement : unsigned char {
        kUnknown = 0,
        kCim,
        kClass,
        kClassName,
        kClassPath,
        kCorrelator,
        kDeclaration,
        kDeclGroup,
        kDeclGroupWithName,
        kDeclGroupWithPath,
        kError,
        kHost,
        kIMethodCall,
        kIMethodResponse,
        kInstance,
        kInstanceName,
        kInstancePath,
        kIParamValue,
        kIReturnValue,
        kKeyBinding,
        kKeyValue,
        kLocalClassPath,
        kLocalInstancePath,
        kLocalNamespacePath,
        kMessage,
        kMethod,
        kMethodCall,
        kMethodResponse,
        kMultiReq,
        kMultiRsp,
        kNamespace,
        kNamespacePath,
        kObjectPath,
        kParameter,
        kParameterArray,
        kParameterRefArray,
        kParameterReference,
        kParamValue,
        kProperty,
        kPropertyArray,
        kPropertyRefArray,
        kPropertyReference,
        kQualifier,
        kQualifierDeclaration,
        kReturnValue,
        kScope,
        kSimpleReq,
        kSimpleRsp,
        kValue,
        kValueArray,
        kValueInstanceWithPath,
        kValueNamedInstance,
        kValueNamedObject,
        kValueNull,
        kValueObject,
        kValueObjectWithLocalPath,
        kValueObjectWithPath,
        kValueRefArray,
        kValueReference,
        kCount  ///< not an element: how many there are
    };

    TCimXmlElement() = delete;

    /// The element of that name, compared byte for byte; kUnknown if there is none. Cost: constant.
    static EElement Find(const char* name) noexcept;
    /// The name of an element, as documents write it; "" for kUnknown.
    static const char* GetName(EElement element) noexcept;
};

}  // namespace NORVZEL20
