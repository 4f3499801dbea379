#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "host/Export.h"
#include "host/ICIMQualifierDecl.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// An instance or a class that is the value of a property (DSP0004, 5.6.3.15 "EmbeddedObject"). It belongs to no namespace and is
/// not checked against a schema: it holds what was read. So its arrays are compared in order: nothing says that they are bags.
///
/// One owner builds it, then it is held as boost::shared_ptr<const TEmbeddedObject> and never changes.
/// Threads: the owner until it is built; afterwards any thread may read it.
class CIMDELTA_INTERNAL_EXPORT TEmbeddedObject {
  public:
    struct TQualifier {
        std::string name;
        TCIMValue value;  ///< a typed null if there is no value
        ICIMQualifierDecl::EFlavor flavor = ICIMQualifierDecl::kFlavorDefault;
        bool propagated = false;
    };
    struct TProperty {
        std::string name;
        TCIMValue value;             ///< a typed null if there is no value
        std::string referenceClass;  ///< the class that a reference may refer to; empty for any
        unsigned int arraySize = 0;  ///< the number of elements of an array of fixed size, otherwise 0
        std::string classOrigin;
        bool propagated = false;
        std::vector<TQualifier> qualifiers;
    };
    struct TParameter {
        std::string name;
        TCIMValue::TCIMType type = TCIMValue::TCIMType::kNone;
        std::string referenceClass;
        unsigned int arraySize = 0;
        std::vector<TQualifier> qualifiers;
    };
    struct TMethod {
        std::string name;
        TCIMValue::TCIMType type = TCIMValue::TCIMType::kNone;  ///< the type of the result; kNone if there is no result
        std::string classOrigin;
        bool propagated = false;
        std::vector<TParameter> parameters;
        std::vector<TQualifier> qualifiers;
    };

    /// An instance of the class `className`, or the class itself.
    explicit TEmbeddedObject(std::string className, bool isClass = false);

    const std::string& GetClassName() const noexcept { return fClassName; }
    bool IsClass() const noexcept { return fIsClass; }
    /// The superclass of a class; empty for a top-level class.
    const std::string& GetSuperClassName() const noexcept { return fSuperClassName; }
    const std::vector<TQualifier>& GetQualifiers() const noexcept { return fQualifiers; }
    const std::vector<TProperty>& GetProperties() const noexcept { return fProperties; }
    const std::vector<TMethod>& GetMethods() const noexcept { return fMethods; }
    /// The first property of that name, in any letter case; null if there is none. Linear.
    const TProperty* FindProperty(std::string_view name) const noexcept;

    void SetSuperClassName(std::string name);
    /// Adding does not check whether the name is there already.
    void AddQualifier(TQualifier qualifier);
    void AddProperty(TProperty property);
    void AddMethod(TMethod method);

    /// Equality by structure: the same class and superclass and, for each name, the same type, value, qualifiers and parameters.
    /// Letter case of names does not matter, nor does the order of qualifiers, properties and methods; the order of parameters
    /// does. In instances, a null property equals a missing one. The origin of an element (class origin, propagated) is ignored.
    bool operator==(const TEmbeddedObject& other) const;
    bool operator!=(const TEmbeddedObject& other) const { return !(*this == other); }
    /// Equal objects have the same hash.
    std::size_t Hash() const;

    /// An INSTANCE or CLASS element (DSP0201) on one line.
    std::string ToText() const;

    /// The object as the text of a key. Two objects without bags have the same key text if and only if they are equal.
    ///
    /// It resembles ToText, but has one spelling and one order for everything that equality ignores: names in lower case, elements
    /// sorted by name, an instance without its null properties, nothing about origins. Values are exact: nothing is replaced
    /// because XML could not hold it. A bag has its elements in the order of their texts.
    std::string GetKeyText() const;

    /// Whether text may be that of an embedded object: if its first character that is no blank is a `<`. Writers that do not mark
    /// objects also write plain text into the same property.
    static bool IsPerhapsText(std::string_view text) noexcept
    {
        const std::size_t start = text.find_first_not_of(" \t\r\n");
        return start != std::string_view::npos && text[start] == '<';
    }

  private:
    std::string fClassName;
    std::string fSuperClassName;
    std::vector<TQualifier> fQualifiers;
    std::vector<TProperty> fProperties;
    std::vector<TMethod> fMethods;
    bool fIsClass;
};

}  // namespace NORVZEL20
