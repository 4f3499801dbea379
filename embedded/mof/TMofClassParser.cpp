// Classes:
//
//     class      [qualifiers] class NAME [as ALIAS] [: NAME] "{" {feature} "}" ;
//     feature    [qualifiers] type NAME ( property | method ) ;
//     type       TYPE | NAME ref
//     property   ["[" [INTEGER] "]"] [= initializer]
//     method     "(" [parameter {, parameter}] ")"
//     parameter  [qualifiers] type NAME ["[" [INTEGER] "]"]
//
// Which feature it is shows only behind its name. Aliases of classes are obsolete and dropped.
#include "embedded/mof/TMofClassParser.h"

#include <utility>

#include "embedded/load/MessageText.h"
#include "embedded/mof/TMofTypeParser.h"
#include "embedded/mof/TMofTyping.h"
#include "embedded/mof/TMofValueParser.h"
#include "embedded/store/TSchemaLimits.h"

namespace NORVZEL20 {

TDraft TMofClassParser::Read(const TLoadPlace& place)
{
    TDraft draft{TEmbeddedObject(fTokens.ExpectName("the name of a class"), true), place, {}, {}};
    for (TEmbeddedObject::TQualifier& qualifier : std::exchange(fOfClass, {})) {
        draft.object.AddQualifier(std::move(qualifier));
    }
    if (fTokens.TakeKeyword("as")) {
        if (!fTokens.Is(TMofToken::kAlias)) {
            fTokens.FailExpected("an alias, such as $Disk");
        }
        fTokens.Advance();
    }
    if (fTokens.TakeSymbol(':')) {
        draft.object.SetSuperClassName(fTokens.ExpectName("the name of the superclass"));
    }
    fTokens.ExpectSymbol('{', "in front of the features of the class");
    while (!fTokens.TakeSymbol('}')) {
        ReadFeature(draft);
    }
    fTokens.ExpectSymbol(';', "behind the class");
    return draft;
}

void TMofClassParser::ReadFeature(TDraft& draft)
{
    TQualifiers qualifiers = fQualifiers.ReadList();
    const TLoadPlace place = fTokens.GetPlace();
    std::string referenceClass;
    const TCIMValue::TCIMType type = TMofTypeParser::ReadTypeOrReference(fTokens, referenceClass);
    std::string name = fTokens.ExpectName("the name of a property or a method");
    if (fTokens.IsSymbol('(')) {
        TEmbeddedObject::TMethod method;
        method.name = std::move(name);
        method.type = type;
        method.qualifiers = std::move(qualifiers);
        ReadMethod(draft, std::move(method));
    } else if (type == TCIMValue::TCIMType::kNone) {
        fTokens.FailExpected("( behind the name of a method without a result");
    } else {
        TEmbeddedObject::TProperty property;
        property.name = std::move(name);
        property.referenceClass = std::move(referenceClass);
        property.qualifiers = std::move(qualifiers);
        ReadProperty(draft, std::move(property), type, place);
    }
    fTokens.ExpectSymbol(';', "behind a property or a method");
}

void TMofClassParser::ReadProperty(TDraft& draft, TEmbeddedObject::TProperty property, TCIMValue::TCIMType type,
                                   const TLoadPlace& place)
{
    TLoadContext& context = fTokens.GetContext();
    type = TMofTypeParser::ReadArraySize(fTokens, type, property.arraySize);
    property.value = TCIMValue::Null(type);
    if (fTokens.TakeSymbol('=')) {
        const TMofValue value = TMofValueParser(fTokens).ReadInitializer();
        const TLoadContext::TAt at(context, place);
        property.value = TMofTyping::ReadDeclared(context, "property " + Quote(property.name), value, type);
        context.GetOwnPlace().MakeLocal(property.value);
    }
    const TLoadContext::TAt at(context, place);
    CheckRoom(draft.object.GetProperties().size(), TSchemaLimits::kMaxProperties, "properties", draft);
    if (draft.object.FindProperty(property.name) != nullptr) {
        fTokens.Fail(DescribeSecondProperty(property.name, "class"));
    }
    draft.object.AddProperty(std::move(property));
    draft.propertyPlaces.push_back(place);
}

void TMofClassParser::ReadMethod(TDraft& draft, TEmbeddedObject::TMethod method)
{
    CheckRoom(draft.object.GetMethods().size(), TSchemaLimits::kMaxMethods, "methods", draft);
    fTokens.ExpectSymbol('(', "in front of the parameters");
    while (!fTokens.TakeSymbol(')')) {
        CheckRoom(method.parameters.size(), TSchemaLimits::kMaxProperties, "parameters of one method", draft);
        method.parameters.push_back(ReadParameter());
        if (!fTokens.IsSymbol(')')) {
            fTokens.ExpectSymbol(',', "or ) behind a parameter");
        }
    }
    draft.object.AddMethod(std::move(method));
}

TEmbeddedObject::TParameter TMofClassParser::ReadParameter()
{
    TEmbeddedObject::TParameter parameter;
    parameter.qualifiers = fQualifiers.ReadList();
    parameter.type = TMofTypeParser::ReadTypeOrReference(fTokens, parameter.referenceClass);
    if (parameter.type == TCIMValue::TCIMType::kNone) {
        fTokens.Fail("found a parameter of type void, expected a type, such as string or uint32");
    }
    parameter.name = fTokens.ExpectName("the name of a parameter");
    parameter.type = TMofTypeParser::ReadArraySize(fTokens, parameter.type, parameter.arraySize);
    return parameter;
}

/// Fails if there are as many as there may be.
void TMofClassParser::CheckRoom(std::size_t count, std::size_t most, const char* what, const TDraft& draft) const
{
    if (count >= most) {
        fTokens.Fail("found more than " + std::to_string(most) + " " + what + " in class " + Quote(draft.object.GetClassName()) +
                     "; split it");
    }
}

}  // namespace NORVZEL20
