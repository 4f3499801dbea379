#pragma once

#include <string>

#include "embedded/cimxml/TCimXmlElement.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// Which element may stand in which, and what to do when it starts and ends: the grammar of CIM-XML (DSP0201) as one table.
///
/// A state says which element is open and what it is a part of. An element that the table does not accept in a state is an error of
/// the document. Cost: Find and GetEndAction are one array access.
class CIMDELTA_INTERNAL_EXPORT TCimXmlTable {
  public:
    enum EState : unsigned char {
        kStart = 0,  ///< before the document's element, which may be a part of an answer too
        kEmbedded,   ///< before the element of an embedded object's text
        kCim,
        kDeclaration,
        kGroup,
        kMessage,
        kMultiRequest,
        kRequest,
        kMultiResponse,
        kResponse,
        kResult,
        kOutput,      ///< PARAMVALUE
        kOutputText,  ///< its VALUE
        kMethodResult,
        kReturned,
        kObject,  ///< VALUE.OBJECT and its relatives
        kClass,
        kInstance,
        kProperty,
        kPropertyArray,
        kPropertyReference,
        kMethod,
        kParameter,
        kQualifier,
        kQualifierDecl,
        kScope,
        kText,  ///< VALUE
        kArray,
        kReferenceArray,
        kNull,
        kReference,
        kClassPath,
        kLocalClassPath,
        kInstancePath,
        kLocalInstancePath,
        kNamespacePath,
        kLocalNamespacePath,
        kNamespace,
        kHost,
        kClassName,
        kInstanceName,
        kKeyBinding,
        kKeyValue,
        kSkipped,  ///< an element with any contents, none of which is loaded
        kStateCount
    };

    /// What to do when an element starts, and when the element of a state ends.
    enum EAction : unsigned char {
        kRefuse = 0,  ///< the element may not stand here
        kNothing,
        kBeginObject,
        kEndObject,
        kBeginClass,
        kEndClass,
        kBeginInstance,
        kEndInstance,
        kBeginProperty,
        kEndProperty,
        kBeginMethod,
        kEndMethod,
        kBeginParameter,
        kEndParameter,
        kBeginQualifier,
        kEndQualifier,
        kBeginQualifierDecl,
        kEndQualifierDecl,
        kReadScope,
        kBeginValue,
        kEndText,
        kBeginArray,
        kEndArray,
        kAddNull,
        kBeginReferenceValue,
        kBeginReference,
        kEndReference,
        kBeginNamespacePath,
        kEndNamespacePath,
        kReadNamespace,
        kEndHost,
        kReadClassName,
        kBeginKeyBinding,
        kEndKeyBinding,
        kBeginKeyValue,
        kEndKeyValue,
        kBeginAnswer,
        kEndAnswer,
        kBeginOutput,
        kEndOutput,
        kRefuseError,
        kRefuseRequest,
        kSkip  ///< leaves the element out and says so in the report
    };

    /// One entry: what follows if an element starts in a state.
    struct TStep {
        EState next;
        EAction action;
    };

    TCimXmlTable() = delete;

    /// The step for `element` in `state`; its action is kRefuse if the element may not stand there.
    static TStep Find(EState state, TCimXmlElement::EElement element) noexcept;
    /// What to do when the element of `state` ends.
    static EAction GetEndAction(EState state) noexcept;
    /// Whether character data may stand in `state`; elsewhere only white space may.
    static bool TakesText(EState state) noexcept
    {
        return state == kText || state == kKeyValue || state == kHost || state == kOutputText || state == kSkipped;
    }
    /// The elements that `state` accepts, for messages: "<A>, <B> or <C>", or "nothing".
    static std::string DescribeExpected(EState state);
};

}  // namespace NORVZEL20
