// The grammar of CIM-XML as a table.
//
// A row says: in this state, this element may start; then go to that state and do that action. The next state belongs to the
// element that has started, and it ends with that element. For example, reading
//
//     <INSTANCE CLASSNAME="Disk"><PROPERTY NAME="Id" TYPE="uint32"><VALUE>5</VALUE></PROPERTY></INSTANCE>
//
// inside of a VALUE.OBJECT goes through
//
//     state       element     next state   action at its start   action at its end
//     kObject     INSTANCE    kInstance    kBeginInstance        kEndInstance
//     kInstance   PROPERTY    kProperty    kBeginProperty        kEndProperty
//     kProperty   VALUE       kText        kBeginValue           kEndText
//
// Elements that mean the same share a state: all groups of declarations are kGroup, all kinds of VALUE.OBJECT are kObject. An
// element without a row is an error, and the rows of the state are then what the message lists as expected. The rows are expanded
// at compile time into an array that is indexed by state and element.
#include "embedded/cimxml/TCimXmlTable.h"

#include <array>
#include <cstddef>
#include <vector>

namespace NORVZEL20 {

namespace {

using T = TCimXmlTable;
using E = TCimXmlElement;

struct TRow {
    T::EState state;
    E::EElement element;
    T::EState next;
    T::EAction action;
};

constexpr TRow kRows[] = {
    // The document's element, further ones by kParts; for an embedded object there is none around it.
    {T::kStart, E::kCim, T::kCim, T::kNothing},
    {T::kStart, E::kIReturnValue, T::kReturned, T::kNothing},
    {T::kStart, E::kError, T::kSkipped, T::kRefuseError},
    {T::kEmbedded, E::kInstance, T::kInstance, T::kBeginInstance},
    {T::kEmbedded, E::kClass, T::kClass, T::kBeginClass},

    // Declarations.
    {T::kCim, E::kDeclaration, T::kDeclaration, T::kNothing},
    {T::kCim, E::kMessage, T::kMessage, T::kNothing},
    {T::kDeclaration, E::kDeclGroup, T::kGroup, T::kNothing},
    {T::kDeclaration, E::kDeclGroupWithName, T::kGroup, T::kNothing},
    {T::kDeclaration, E::kDeclGroupWithPath, T::kGroup, T::kNothing},

    // Recorded answers: the objects in them are loaded, what only refers to objects is left out. Requests and errors are refused.
    {T::kMessage, E::kSimpleRsp, T::kResponse, T::kNothing},
    {T::kMessage, E::kMultiRsp, T::kMultiResponse, T::kNothing},
    {T::kMessage, E::kSimpleReq, T::kRequest, T::kNothing},
    {T::kMessage, E::kMultiReq, T::kMultiRequest, T::kNothing},
    {T::kMultiRequest, E::kSimpleReq, T::kRequest, T::kNothing},
    {T::kRequest, E::kCorrelator, T::kSkipped, T::kNothing},
    {T::kRequest, E::kIMethodCall, T::kSkipped, T::kRefuseRequest},
    {T::kRequest, E::kMethodCall, T::kSkipped, T::kRefuseRequest},
    {T::kMultiResponse, E::kSimpleRsp, T::kResponse, T::kNothing},
    {T::kResponse, E::kIMethodResponse, T::kResult, T::kBeginAnswer},
    {T::kResponse, E::kMethodResponse, T::kMethodResult, T::kSkip},
    {T::kMethodResult, E::kError, T::kSkipped, T::kRefuseError},
    {T::kMethodResult, E::kReturnValue, T::kSkipped, T::kNothing},
    {T::kMethodResult, E::kParamValue, T::kSkipped, T::kNothing},
    {T::kResult, E::kError, T::kSkipped, T::kRefuseError},
    {T::kResult, E::kIReturnValue, T::kReturned, T::kNothing},
    {T::kResult, E::kParamValue, T::kOutput, T::kBeginOutput},
    {T::kOutput, E::kValue, T::kOutputText, T::kNothing},
    {T::kOutput, E::kValueNull, T::kSkipped, T::kNothing},
    {T::kOutput, E::kValueArray, T::kSkipped, T::kNothing},
    {T::kOutput, E::kValueReference, T::kSkipped, T::kNothing},
    {T::kOutput, E::kValueRefArray, T::kSkipped, T::kNothing},
    {T::kOutput, E::kValueNamedInstance, T::kSkipped, T::kNothing},
    {T::kOutput, E::kClassName, T::kSkipped, T::kNothing},
    {T::kOutput, E::kInstanceName, T::kSkipped, T::kNothing},
    {T::kOutput, E::kClass, T::kSkipped, T::kNothing},
    {T::kOutput, E::kInstance, T::kSkipped, T::kNothing},
    {T::kReturned, E::kClass, T::kClass, T::kBeginClass},
    {T::kReturned, E::kInstance, T::kInstance, T::kBeginInstance},
    {T::kReturned, E::kQualifierDeclaration, T::kQualifierDecl, T::kBeginQualifierDecl},
    {T::kReturned, E::kValueObject, T::kObject, T::kBeginObject},
    {T::kReturned, E::kValueNamedInstance, T::kObject, T::kBeginObject},
    {T::kReturned, E::kValueNamedObject, T::kObject, T::kBeginObject},
    {T::kReturned, E::kValueObjectWithPath, T::kObject, T::kBeginObject},
    {T::kReturned, E::kValueObjectWithLocalPath, T::kObject, T::kBeginObject},
    {T::kReturned, E::kValueInstanceWithPath, T::kObject, T::kBeginObject},
    {T::kReturned, E::kClassName, T::kSkipped, T::kSkip},
    {T::kReturned, E::kInstanceName, T::kSkipped, T::kSkip},
    {T::kReturned, E::kInstancePath, T::kSkipped, T::kSkip},
    {T::kReturned, E::kLocalInstancePath, T::kSkipped, T::kSkip},
    {T::kReturned, E::kClassPath, T::kSkipped, T::kSkip},
    {T::kReturned, E::kLocalClassPath, T::kSkipped, T::kSkip},
    {T::kReturned, E::kObjectPath, T::kSkipped, T::kSkip},
    {T::kReturned, E::kValue, T::kSkipped, T::kSkip},
    {T::kReturned, E::kValueArray, T::kSkipped, T::kSkip},
    {T::kReturned, E::kValueReference, T::kSkipped, T::kSkip},

    // The contents of a group, and of the VALUE.OBJECTs in it.
    {T::kGroup, E::kLocalNamespacePath, T::kLocalNamespacePath, T::kBeginNamespacePath},
    {T::kGroup, E::kNamespacePath, T::kNamespacePath, T::kBeginNamespacePath},
    {T::kGroup, E::kQualifierDeclaration, T::kQualifierDecl, T::kBeginQualifierDecl},
    {T::kGroup, E::kValueObject, T::kObject, T::kBeginObject},
    {T::kGroup, E::kValueNamedObject, T::kObject, T::kBeginObject},
    {T::kGroup, E::kValueNamedInstance, T::kObject, T::kBeginObject},
    {T::kGroup, E::kValueObjectWithPath, T::kObject, T::kBeginObject},
    {T::kGroup, E::kValueObjectWithLocalPath, T::kObject, T::kBeginObject},
    {T::kGroup, E::kValueInstanceWithPath, T::kObject, T::kBeginObject},
    {T::kGroup, E::kClass, T::kClass, T::kBeginClass},
    {T::kGroup, E::kInstance, T::kInstance, T::kBeginInstance},

    {T::kObject, E::kClass, T::kClass, T::kBeginClass},
    {T::kObject, E::kInstance, T::kInstance, T::kBeginInstance},
    {T::kObject, E::kClassPath, T::kClassPath, T::kNothing},
    {T::kObject, E::kLocalClassPath, T::kLocalClassPath, T::kNothing},
    {T::kObject, E::kInstancePath, T::kInstancePath, T::kNothing},
    {T::kObject, E::kLocalInstancePath, T::kLocalInstancePath, T::kNothing},
    {T::kObject, E::kInstanceName, T::kInstanceName, T::kReadClassName},

    // Classes, instances and what they consist of.
    {T::kClass, E::kQualifier, T::kQualifier, T::kBeginQualifier},
    {T::kClass, E::kProperty, T::kProperty, T::kBeginProperty},
    {T::kClass, E::kPropertyArray, T::kPropertyArray, T::kBeginProperty},
    {T::kClass, E::kPropertyReference, T::kPropertyReference, T::kBeginProperty},
    {T::kClass, E::kPropertyRefArray, T::kPropertyArray, T::kBeginProperty},
    {T::kClass, E::kMethod, T::kMethod, T::kBeginMethod},
    {T::kInstance, E::kQualifier, T::kQualifier, T::kBeginQualifier},
    {T::kInstance, E::kProperty, T::kProperty, T::kBeginProperty},
    {T::kInstance, E::kPropertyArray, T::kPropertyArray, T::kBeginProperty},
    {T::kInstance, E::kPropertyReference, T::kPropertyReference, T::kBeginProperty},
    {T::kInstance, E::kPropertyRefArray, T::kPropertyArray, T::kBeginProperty},
    {T::kProperty, E::kQualifier, T::kQualifier, T::kBeginQualifier},
    {T::kProperty, E::kValue, T::kText, T::kBeginValue},
    {T::kProperty, E::kValueNull, T::kNull, T::kBeginValue},
    {T::kPropertyArray, E::kQualifier, T::kQualifier, T::kBeginQualifier},
    {T::kPropertyArray, E::kValueArray, T::kArray, T::kBeginArray},
    {T::kPropertyArray, E::kValueRefArray, T::kReferenceArray, T::kBeginArray},
    {T::kPropertyArray, E::kValueNull, T::kNull, T::kBeginValue},
    {T::kPropertyReference, E::kQualifier, T::kQualifier, T::kBeginQualifier},
    {T::kPropertyReference, E::kValueReference, T::kReference, T::kBeginReferenceValue},
    {T::kPropertyReference, E::kValueNull, T::kNull, T::kBeginValue},
    {T::kMethod, E::kQualifier, T::kQualifier, T::kBeginQualifier},
    {T::kMethod, E::kParameter, T::kParameter, T::kBeginParameter},
    {T::kMethod, E::kParameterArray, T::kParameter, T::kBeginParameter},
    {T::kMethod, E::kParameterReference, T::kParameter, T::kBeginParameter},
    {T::kMethod, E::kParameterRefArray, T::kParameter, T::kBeginParameter},
    {T::kParameter, E::kQualifier, T::kQualifier, T::kBeginQualifier},
    {T::kQualifier, E::kValue, T::kText, T::kBeginValue},
    {T::kQualifier, E::kValueArray, T::kArray, T::kBeginArray},
    {T::kQualifierDecl, E::kScope, T::kScope, T::kReadScope},
    {T::kQualifierDecl, E::kValue, T::kText, T::kBeginValue},
    {T::kQualifierDecl, E::kValueArray, T::kArray, T::kBeginArray},
    {T::kArray, E::kValue, T::kText, T::kBeginValue},
    {T::kArray, E::kValueNull, T::kNull, T::kAddNull},
    {T::kReferenceArray, E::kValueReference, T::kReference, T::kBeginReference},
    {T::kReferenceArray, E::kValueNull, T::kNull, T::kAddNull},

    // Object paths.
    {T::kReference, E::kClassPath, T::kClassPath, T::kNothing},
    {T::kReference, E::kLocalClassPath, T::kLocalClassPath, T::kNothing},
    {T::kReference, E::kClassName, T::kClassName, T::kReadClassName},
    {T::kReference, E::kInstancePath, T::kInstancePath, T::kNothing},
    {T::kReference, E::kLocalInstancePath, T::kLocalInstancePath, T::kNothing},
    {T::kReference, E::kInstanceName, T::kInstanceName, T::kReadClassName},
    {T::kClassPath, E::kNamespacePath, T::kNamespacePath, T::kBeginNamespacePath},
    {T::kClassPath, E::kClassName, T::kClassName, T::kReadClassName},
    {T::kLocalClassPath, E::kLocalNamespacePath, T::kLocalNamespacePath, T::kBeginNamespacePath},
    {T::kLocalClassPath, E::kClassName, T::kClassName, T::kReadClassName},
    {T::kInstancePath, E::kNamespacePath, T::kNamespacePath, T::kBeginNamespacePath},
    {T::kInstancePath, E::kInstanceName, T::kInstanceName, T::kReadClassName},
    {T::kLocalInstancePath, E::kLocalNamespacePath, T::kLocalNamespacePath, T::kBeginNamespacePath},
    {T::kLocalInstancePath, E::kInstanceName, T::kInstanceName, T::kReadClassName},
    {T::kNamespacePath, E::kHost, T::kHost, T::kNothing},
    {T::kNamespacePath, E::kLocalNamespacePath, T::kLocalNamespacePath, T::kNothing},
    {T::kLocalNamespacePath, E::kNamespace, T::kNamespace, T::kReadNamespace},
    {T::kInstanceName, E::kKeyBinding, T::kKeyBinding, T::kBeginKeyBinding},
    {T::kInstanceName, E::kKeyValue, T::kKeyValue, T::kBeginKeyValue},
    {T::kInstanceName, E::kValueReference, T::kReference, T::kBeginReference},
    {T::kKeyBinding, E::kKeyValue, T::kKeyValue, T::kBeginKeyValue},
    {T::kKeyBinding, E::kValueReference, T::kReference, T::kBeginReference},
};

// Of a recorded answer, or of declarations, users keep a part too: what may stand in these states may stand alone.
constexpr T::EState kParts[] = {T::kCim, T::kDeclaration, T::kMessage, T::kResponse, T::kReturned};

constexpr bool IsRowOf(const TRow& row, T::EState state)
{
    bool isPart = false;
    for (const T::EState part : kParts) {
        isPart = isPart || (state == T::kStart && row.state == part);
    }
    return row.state == state || isPart;
}

constexpr std::array<T::EAction, T::kStateCount> MakeEndActions()
{
    std::array<T::EAction, T::kStateCount> actions{};
    for (T::EAction& action : actions) {
        action = T::kNothing;
    }
    actions[T::kResult] = T::kEndAnswer;
    actions[T::kOutputText] = T::kEndOutput;
    actions[T::kObject] = T::kEndObject;
    actions[T::kClass] = T::kEndClass;
    actions[T::kInstance] = T::kEndInstance;
    actions[T::kProperty] = T::kEndProperty;
    actions[T::kPropertyArray] = T::kEndProperty;
    actions[T::kPropertyReference] = T::kEndProperty;
    actions[T::kMethod] = T::kEndMethod;
    actions[T::kParameter] = T::kEndParameter;
    actions[T::kQualifier] = T::kEndQualifier;
    actions[T::kQualifierDecl] = T::kEndQualifierDecl;
    actions[T::kText] = T::kEndText;
    actions[T::kArray] = T::kEndArray;
    actions[T::kReferenceArray] = T::kEndArray;
    actions[T::kReference] = T::kEndReference;
    actions[T::kNamespacePath] = T::kEndNamespacePath;
    actions[T::kLocalNamespacePath] = T::kEndNamespacePath;
    actions[T::kHost] = T::kEndHost;
    actions[T::kKeyBinding] = T::kEndKeyBinding;
    actions[T::kKeyValue] = T::kEndKeyValue;
    return actions;
}

using TSteps = std::array<std::array<T::TStep, E::kCount>, T::kStateCount>;

constexpr TSteps MakeSteps()
{
    TSteps steps{};
    for (const TRow& row : kRows) {
        steps[row.state][row.element] = {row.next, row.action};
        if (IsRowOf(row, T::kStart)) {
            steps[T::kStart][row.element] = {row.next, row.action};
        }
    }
    for (T::TStep& step : steps[T::kSkipped]) {  // anything may stand in what is left out
        step = {T::kSkipped, T::kNothing};
    }
    return steps;
}

constexpr TSteps kSteps = MakeSteps();
constexpr std::array<T::EAction, T::kStateCount> kEndActions = MakeEndActions();

}  // namespace

TCimXmlTable::TStep TCimXmlTable::Find(EState state, TCimXmlElement::EElement element) noexcept
{
    return kSteps[state][element];
}

TCimXmlTable::EAction TCimXmlTable::GetEndAction(EState state) noexcept
{
    return kEndActions[state];
}

std::string TCimXmlTable::DescribeExpected(EState state)
{
    std::vector<std::string> names;
    for (const TRow& row : kRows) {
        if (IsRowOf(row, state)) {
            names.push_back(std::string("<") + TCimXmlElement::GetName(row.element) + ">");
        }
    }
    if (names.empty()) {
        return "nothing";
    }
    std::string text = names.front();
    for (std::size_t next = 1; next < names.size(); ++next) {
        text += (next + 1 == names.size() ? " or " : ", ") + names[next];
    }
    return text;
}

}  // namespace NORVZEL20
