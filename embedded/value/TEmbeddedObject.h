#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "host/ICIMQualifierDecl.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// An instance or a class that is the value of a property (DSP0004, 5.6.3.15 "EmbeddedObject"). It belongs to no namespace and
/// follows no schema: what stands here is what was read.
///
/// Built by one owner, then held as boost::shared_ptr<const TEmbeddedObject> and never changed again; from then on any thread may
/// read it.
class TEmbeddedObject {
  public:
    struct TQualifier {
        std::string fName;
        TCIMValue fValue;  ///< a typed null where there is no value
        ICIMQualifierDecl::EFlavor fFlavor = ICIMQualifierDecl::kFlavorDefault;
        bool fPropagated = false;
    };
    struct TProperty {
        std::string fName;
        TCIMValue fValue;             ///< a typed null where there is no value
        std::string fReferenceClass;  ///< of a reference; empty where none is named
        unsigned int fArraySize = 0;  ///< of an array of fixed size, else 0
        std::string fClassOrigin;
        bool fPropagated = false;
        std::vector<TQualifier> fQualifiers;
    };
    struct TParameter {
        std::string fName;
        TCIMValue::TCIMType fType = TCIMValue::TCIMType::kNone;
        std::string fReferenceClass;
        unsigned int fArraySize = 0;
        std::vector<TQualifier> fQualifiers;
    };
    struct TMethod {
        std::string fName;
        TCIMValue::TCIMType fType = TCIMValue::TCIMType::kNone;  ///< of the result; kNone for none
        std::string fClassOrigin;
        bool fPropagated = false;
        std::vector<TParameter> fParameters;
        std::vector<TQualifier> fQualifiers;
    };

    /// An instance of the class `className`, or that class itself.
    explicit TEmbeddedObject(std::string className, bool isClass = false);

    const std::string& GetClassName() const noexcept { return fClassName; }
    bool IsClass() const noexcept { return fIsClass; }
    /// Of a class; empty where it is a top-level class.
    const std::string& GetSuperClassName() const noexcept { return fSuperClassName; }
    const std::vector<TQualifier>& GetQualifiers() const noexcept { return fQualifiers; }
    const std::vector<TProperty>& GetProperties() const noexcept { return fProperties; }
    const std::vector<TMethod>& GetMethods() const noexcept { return fMethods; }
    /// Null where there is none of that name; letter case does not count. Linear.
    const TProperty* FindProperty(std::string_view name) const noexcept;

    void SetSuperClassName(std::string name);
    /// Nobody looks whether there is one of that name already; the first one is found.
    void AddQualifier(TQualifier qualifier);
    void AddProperty(TProperty property);
    void AddMethod(TMethod method);

    /// Equality by structure: class and superclass, and for each name the same type and value, qualifiers, parameters. Letter
    /// case of names and the order of qualifiers, properties and methods do not count, the order of parameters does. A property
    /// that is null equals one that is missing, where both are instances. Where an element came from (class origin, propagated)
    /// does not count.
    bool operator==(const TEmbeddedObject& other) const;
    bool operator!=(const TEmbeddedObject& other) const { return !(*this == other); }
    /// Agrees with operator==.
    std::size_t Hash() const;

    /// An INSTANCE or CLASS element (DSP0201) on one line.
    std::string ToText() const;

  private:
    std::string fClassName;
    std::string fSuperClassName;
    std::vector<TQualifier> fQualifiers;
    std::vector<TProperty> fProperties;
    std::vector<TMethod> fMethods;
    bool fIsClass;
};

}  // namespace NORVZEL20
