#pragma once

#include <string>

#include "embedded/cimxml/TCimXmlElement.h"

namespace NORVZEL20 {

/// Which element may stand in which, and what reading it does: the states of a CIM-XML reader (DSP0201), as one table.
///
/// A state tells which element is open and what it belongs to. An element that the table does not accept in a state is an error
/// of the document.
class TCimXmlTable {
  public:
    enum EState : unsigned char {
        kStart = 0,  ///< before the document's element
        kEmbedded,   ///< before the element of an embedded object's text
        kCim,
        kDeclaration,
        kGroup,
        kMessage,
        kMultiRequest,
        kRequest,
        kCall,
        kCallParameter,
        kMultiResponse,
        kResponse,
        kResult,
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
        kError,
        kSkipped,  ///< something that holds nothing to load
        kStateCount
    };

    /// What the start of an element does, and the end of a state.
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
        kBeginText,
        kEndText,
        kBeginArray,
        kEndArray,
        kAddNull,
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
        kReadError,
        kSkip  ///< leaves something out, and says so in the report
    };

    /// One entry: what reading an element in a state leads to.
    struct TStep {
        EState next;
        EAction action;
    };

    TCimXmlTable() = delete;

    /// The step for `element` in `state`; its action is kRefuse where the element may not stand there.
    static TStep Find(EState state, TCimXmlElement::EElement element) noexcept;
    /// What is done when the element of `state` ends.
    static EAction GetEndAction(EState state) noexcept;
    /// Whether character data means something in `state`.
    static bool TakesText(EState state) noexcept
    {
        return state == kText || state == kKeyValue || state == kHost || state == kSkipped;
    }
    /// The elements that `state` accepts, for messages: "<A>, <B> or <C>", or "nothing".
    static std::string DescribeExpected(EState state);
};

}  // namespace NORVZEL20
