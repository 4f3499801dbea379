#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "embedded/load/TDraft.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/load/TQualifierDraft.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

/// Finds out how classes that nothing declares may be declared, from their instances.
///
/// Errors: every operation fails through the context, at the place of the instance or property concerned.
class TClassInference {
  public:
    /// `context` must outlive this.
    explicit TClassInference(TLoadContext& context) noexcept : fContext(context) {}

    /// Takes an instance into account. Errors: kTypeMismatch (13) if a property has another type than in an instance before, or if
    /// the name of the instance has other keys.
    void Note(const TDraft& instance);

    /// The classes in the order of their first instances, and an entry for each in TLoadReport::inferred. Errors: kNotFound (15)
    /// if no instance of a class has a name, because the keys of the class are not known then.
    std::vector<TDraft> MakeClasses() const;

    /// The declarations of the qualifiers that these classes have.
    static std::vector<TQualifierDraft> DescribeQualifiers();

  private:
    using TType = TCIMValue::TCIMType;

    struct TProperty {
        std::string name;
        TType type;
        TLoadPlace place;       // of the first one
        bool isObject = false;  // an embedded object is a value of it
        bool isOfName = false;  // known from names alone, so its type is only what a name shows
        bool isKey = false;
        bool isBeyondSigned = false;  // a name gives a number too large for sint64
    };

    struct TClass {
        std::string name;
        TLoadPlace place;               // of the first instance
        bool hasKeys = false;           // an instance has had a name
        TLoadPlace keyPlace;            // of the first instance with a name
        std::vector<std::string> keys;  // of that name
        std::vector<TProperty> properties;
        TNameMap<std::size_t> numbers;  // of the properties, by name
    };

    TClass& FindClass(const TDraft& instance);
    static TProperty& FindProperty(TClass& cls, const std::string& name, TType type, const TLoadPlace& place);
    void NoteProperty(TClass& cls, const TEmbeddedObject::TProperty& property, const TLoadPlace& place);
    void NoteKeys(TClass& cls, const TDraft& instance);
    void NoteKey(TClass& cls, const std::string& name, const TCIMValue& value, const TLoadPlace& place);
    [[noreturn]] void FailType(const TClass& cls, const TProperty& known, TType type) const;
    TDraft MakeClass(const TClass& cls) const;

    TLoadContext& fContext;
    std::vector<TClass> fClasses;
    TNameMap<std::size_t> fNumbers;  // of the classes, by name
};

}  // namespace NORVZEL20
