// Values and instances:
//
//     initializer  element | array
//     array        { [element {, element}] }
//     element      TEXT {TEXT} | INTEGER | REAL | CHARACTER | true | false | null | ALIAS | instance
//     instance     [qualifiers] instance of NAME [as ALIAS] { {property} }
//     property     [qualifiers] NAME = initializer ;
//
// Texts that follow each other are one. Qualifiers of instances and of their properties are obsolete and mean nothing to a store:
// they are read and dropped.
#include "embedded/mof/TMofValueParser.h"

#include <utility>

#include "embedded/load/MessageText.h"
#include "embedded/mof/TMofQualifierParser.h"
#include "embedded/store/TSchemaLimits.h"

namespace NORVZEL20 {

TMofValue TMofValueParser::ReadInitializer()
{
    return fTokens.IsSymbol('{') ? ReadArray() : ReadElement();
}

TMofValue TMofValueParser::ReadArray()
{
    TMofValue array;
    array.kind = TMofValue::kArray;
    fTokens.ExpectSymbol('{', "in front of the elements of an array");
    while (!fTokens.TakeSymbol('}')) {
        array.elements.push_back(ReadElement());
        if (!fTokens.IsSymbol('}')) {
            fTokens.ExpectSymbol(',', "or } behind an element of an array");
        }
    }
    return array;
}

TMofValue TMofValueParser::ReadElement()
{
    static constexpr std::pair<TMofToken::EKind, TMofValue::EKind> kKinds[] = {{TMofToken::kInteger, TMofValue::kInteger},
                                                                               {TMofToken::kReal, TMofValue::kReal},
                                                                               {TMofToken::kCharacter, TMofValue::kCharacter},
                                                                               {TMofToken::kAlias, TMofValue::kAlias}};
    if (fTokens.Is(TMofToken::kText)) {
        return ReadText();
    }
    for (const auto& [tokenKind, valueKind] : kKinds) {
        if (fTokens.Is(tokenKind)) {
            TMofValue value;
            value.kind = valueKind;
            value.text = fTokens.Get().text;
            fTokens.Advance();
            return value;
        }
    }
    return ReadWord();
}

TMofValue TMofValueParser::ReadText()
{
    TMofValue value;
    value.kind = TMofValue::kText;
    for (; fTokens.Is(TMofToken::kText); fTokens.Advance()) {
        value.text += fTokens.Get().text;
    }
    return value;
}

TMofValue TMofValueParser::ReadWord()
{
    TMofValue value;
    if (fTokens.TakeKeyword("null")) {
        return value;
    }
    if (fTokens.IsKeyword("instance") || fTokens.IsSymbol('[')) {
        return ReadObject();
    }
    value.kind = TMofValue::kBoolean;
    if (fTokens.TakeKeyword("true")) {
        value.text = "TRUE";
    } else if (fTokens.TakeKeyword("false")) {
        value.text = "FALSE";
    } else {
        fTokens.FailExpected("a value: a text in double quotes, a number, a character in single quotes, true, false, null, an alias"
                             " or an instance");
    }
    return value;
}

TMofValue TMofValueParser::ReadObject()
{
    TMofValue value;
    value.kind = TMofValue::kObject;
    const TLoadContext::TEmbedded embedded(fTokens.GetContext());
    TMofQualifierParser::Skip(fTokens);
    const TLoadPlace place = fTokens.GetPlace();
    fTokens.ExpectKeyword("instance");
    value.object = std::make_shared<const TMofInstance>(ReadInstance(place));
    return value;
}

TMofInstance TMofValueParser::ReadInstance(const TLoadPlace& place)
{
    TMofInstance instance;
    instance.place = place;
    fTokens.ExpectKeyword("of");
    instance.className = fTokens.ExpectName("the name of a class");
    if (fTokens.TakeKeyword("as")) {
        if (!fTokens.Is(TMofToken::kAlias)) {
            fTokens.FailExpected("an alias, such as $Disk");
        }
        instance.alias = fTokens.Get().text;
        fTokens.Advance();
    }
    fTokens.ExpectSymbol('{', "in front of the properties of the instance");
    while (!fTokens.TakeSymbol('}')) {
        AddProperty(instance, ReadProperty());
    }
    return instance;
}

TMofInstance::TProperty TMofValueParser::ReadProperty()
{
    TMofQualifierParser::Skip(fTokens);
    TMofInstance::TProperty property;
    property.place = fTokens.GetPlace();
    property.name = fTokens.ExpectName("the name of a property or }");
    fTokens.ExpectSymbol('=', "behind the name of the property");
    property.value = ReadInitializer();
    fTokens.ExpectSymbol(';', "behind the value of the property");
    return property;
}

void TMofValueParser::AddProperty(TMofInstance& instance, TMofInstance::TProperty property) const
{
    TLoadContext& context = fTokens.GetContext();
    const TLoadContext::TAt at(context, property.place);
    if (instance.properties.size() == TSchemaLimits::kMaxProperties) {
        fTokens.Fail("found more than " + std::to_string(TSchemaLimits::kMaxProperties) + " properties in an instance of class " +
                     Quote(instance.className) + "; split it");
    }
    if (instance.FindProperty(property.name) != nullptr) {
        fTokens.Fail(DescribeSecondProperty(property.name, "instance"));
    }
    instance.properties.push_back(std::move(property));
}

}  // namespace NORVZEL20
