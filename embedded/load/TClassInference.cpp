// Classes from their instances.
//
//     properties   those of all instances together, each with the type that its element names; null ones count
//     keys         those in the names in front of instances; all names must have the same ones
//     key types    that of the property. If no instance has the property, that of the key in the name: a number without TYPE is
//                  uint64, sint64 if one is negative, and real64 if one has a fraction, or if one is negative and another
//                  too large for sint64
//
// A reference may refer to any class, because the next instance may refer to another one. A property with an embedded object gets
// the qualifier EmbeddedObject, and a class with a reference the qualifier Association. Nothing is known of superclasses,
// methods, defaults and other qualifiers, so there are none.
#include "embedded/load/TClassInference.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <cstdint>
#include <limits>

#include "embedded/load/MessageText.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

using EStatus = TZELStatusCode::EStatusCode;

namespace {

constexpr char kKey[] = "Key";
constexpr char kAssociation[] = "Association";
constexpr char kEmbeddedObject[] = "EmbeddedObject";

bool HoldsObject(const TCIMValue& value)
{
    if (value.GetType() == TCIMValue::TCIMType::kString) {
        return TValueAccess::GetForm(value) == TValueAccess::kObject;
    }
    return false;
}

TEmbeddedObject::TQualifier TrueQualifier(const char* name)
{
    TEmbeddedObject::TQualifier qualifier;
    qualifier.name = name;
    qualifier.value = TCIMValue(true);
    qualifier.flavor = ICIMQualifierDecl::kFlavorToSubclass;
    return qualifier;
}

bool IsNumberOfName(TCIMValue::TCIMType type)
{
    using TType = TCIMValue::TCIMType;
    return type == TType::kUint64 || type == TType::kSint64 || type == TType::kReal64;
}

// Whether no sint64 is that large.
bool IsBeyondSigned(const TCIMValue& value)
{
    return value.GetType() == TCIMValue::TCIMType::kUint64 &&
           value.GetUnsigned() > static_cast<std::uint64_t>(std::numeric_limits<std::int64_t>::max());
}

}  // namespace

std::vector<TQualifierDraft> TClassInference::DescribeQualifiers()
{
    using TScope = ICIMQualifierDecl::EScope;
    const auto describe = [](const char* name, unsigned int scope) {
        return TQualifierDraft{name, TCIMValue(false), static_cast<TScope>(scope), ICIMQualifierDecl::kFlavorToSubclass};
    };
    return {describe(kKey, TScope::kScopeProperty | TScope::kScopeReference), describe(kAssociation, TScope::kScopeAssociation),
            describe(kEmbeddedObject, TScope::kScopeProperty | TScope::kScopeMethod | TScope::kScopeParameter)};
}

void TClassInference::Note(const TDraft& instance)
{
    TClass& cls = FindClass(instance);
    const std::vector<TEmbeddedObject::TProperty>& properties = instance.object.GetProperties();
    for (std::size_t i = 0; i < properties.size(); ++i) {
        NoteProperty(cls, properties[i], instance.propertyPlaces[i]);
    }
    if (instance.hasName) {
        NoteKeys(cls, instance);
    }
}

TClassInference::TClass& TClassInference::FindClass(const TDraft& instance)
{
    const std::string& name = instance.object.GetClassName();
    const auto known = fNumbers.find(name);
    if (known != fNumbers.end()) {
        return fClasses[known->second];
    }
    fNumbers.emplace(name, fClasses.size());
    fClasses.emplace_back();
    fClasses.back().name = name;
    fClasses.back().place = instance.place;
    return fClasses.back();
}

void TClassInference::NoteProperty(TClass& cls, const TEmbeddedObject::TProperty& property, const TLoadPlace& place)
{
    const TType type = property.value.GetType();
    TProperty& known = FindProperty(cls, property.name, type, place);
    if (known.isOfName) {
        known.isOfName = false;
        known.type = type;
        known.place = place;
    }
    if (known.type != type) {
        const TLoadContext::TAt at(fContext, place);
        FailType(cls, known, type);
    }
    known.isObject = known.isObject || HoldsObject(property.value);
}

/// The property of that name, made if it is new.
TClassInference::TProperty& TClassInference::FindProperty(TClass& cls, const std::string& name, TType type, const TLoadPlace& place)
{
    const auto known = cls.numbers.find(name);
    if (known != cls.numbers.end()) {
        return cls.properties[known->second];
    }
    cls.numbers.emplace(name, cls.properties.size());
    cls.properties.push_back({name, type, place, false, false, false, false});
    return cls.properties.back();
}

void TClassInference::FailType(const TClass& cls, const TProperty& known, TType type) const
{
    fContext.Fail(EStatus::kTypeMismatch,
                  "found property " + Quote(known.name) + " of class " + Quote(cls.name) + " as " + TValueText::DescribeType(type) +
                      ", but as " + TValueText::DescribeType(known.type) + " at " + fContext.Describe(known.place) +
                      "; the class is not declared, so give its declaration",
                  EAdvice::kGiveDeclaration);
}

void TClassInference::NoteKeys(TClass& cls, const TDraft& instance)
{
    std::vector<std::string> names;
    for (const auto& key : instance.ownKeys) {
        if (key.first.empty()) {
            const TLoadContext::TAt at(fContext, instance.place);
            fContext.Fail(EStatus::kParseError,
                          "found a name of an instance of class " + Quote(cls.name) +
                              " with a value that names no key; the class is not declared, so give its declaration",
                          EAdvice::kGiveDeclaration);
        }
        names.push_back(key.first);
    }
    std::sort(names.begin(), names.end(), [](const auto& a, const auto& b) { return TNameText::TLess()(a, b); });
    if (!cls.hasKeys) {
        cls.hasKeys = true;
        cls.keys = names;
        cls.keyPlace = instance.place;
    }
    const bool areSame = std::equal(names.begin(), names.end(), cls.keys.begin(), cls.keys.end(),
                                    [](const auto& a, const auto& b) { return TNameText::Equal(a, b); });
    const TLoadContext::TAt at(fContext, instance.place);
    if (!areSame) {
        const auto shown = [](const std::vector<std::string>& keys) {
            return keys.empty() ? std::string("no keys") : "the keys " + Quote(boost::algorithm::join(keys, ", "));
        };
        fContext.Fail(EStatus::kTypeMismatch,
                      "found " + shown(names) + " in the name of an instance of class " + Quote(cls.name) + ", but " +
                          shown(cls.keys) + " at " + fContext.Describe(cls.keyPlace) +
                          "; the class is not declared, so give its declaration",
                      EAdvice::kGiveDeclaration);
    }
    for (const auto& [name, value] : instance.ownKeys) {
        NoteKey(cls, name, value, instance.place);
    }
}

void TClassInference::NoteKey(TClass& cls, const std::string& name, const TCIMValue& value, const TLoadPlace& place)
{
    const TType type = value.GetType();
    const std::size_t before = cls.properties.size();
    TProperty& known = FindProperty(cls, name, type, place);
    known.isOfName = known.isOfName || cls.properties.size() > before;
    known.isKey = true;
    known.isBeyondSigned = known.isBeyondSigned || IsBeyondSigned(value);
    if (!known.isOfName || known.type == type) {
        return;
    }
    if (!IsNumberOfName(type) || !IsNumberOfName(known.type)) {
        FailType(cls, known, type);
    }
    const bool isReal = known.type == TType::kReal64 || type == TType::kReal64 || known.isBeyondSigned;
    known.type = isReal ? TType::kReal64 : TType::kSint64;
}

std::vector<TDraft> TClassInference::MakeClasses() const
{
    std::vector<TDraft> classes;
    for (const TClass& cls : fClasses) {
        if (!cls.hasKeys) {
            const TLoadContext::TAt at(fContext, cls.place);
            fContext.Fail(EStatus::kNotFound,
                          "found an instance of class " + Quote(cls.name) +
                              ", which is not declared, and no instance of it has a name with its keys; give its "
                              "declaration",
                          EAdvice::kGiveDeclaration);
        }
        classes.push_back(MakeClass(cls));
        TLoadReport::TInferred inferred = {cls.name, {}};
        for (const TProperty& property : cls.properties) {
            if (property.isKey) {
                inferred.keys.push_back(property.name);
            }
        }
        fContext.GetReport().inferred.push_back(std::move(inferred));
    }
    return classes;
}

TDraft TClassInference::MakeClass(const TClass& cls) const
{
    TDraft draft = {TEmbeddedObject(cls.name, true), cls.place, {}, {}, false, false};
    bool hasReference = false;
    for (const TProperty& known : cls.properties) {
        TEmbeddedObject::TProperty property;
        property.name = known.name;
        property.value = TCIMValue::Null(known.type);
        if (known.isKey) {
            property.qualifiers.push_back(TrueQualifier(kKey));
        }
        if (known.isObject) {
            property.qualifiers.push_back(TrueQualifier(kEmbeddedObject));
        }
        hasReference = hasReference || known.type == TType::kReference;
        draft.object.AddProperty(std::move(property));
        draft.propertyPlaces.push_back(known.place);
    }
    if (hasReference) {
        draft.object.AddQualifier(TrueQualifier(kAssociation));
    }
    return draft;
}

}  // namespace NORVZEL20
