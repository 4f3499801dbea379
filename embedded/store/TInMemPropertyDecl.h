#pragma once

#include <boost/smart_ptr/enable_shared_from_this.hpp>
#include <boost/smart_ptr/weak_ptr.hpp>
#include <string>

#include "embedded/store/TInMemNamedElement.h"
#include "embedded/store/TInMemStaticProperty.h"
#include "host/Export.h"
#include "host/ICIMPropertyDecl.h"

namespace NORVZEL20 {

class TInMemClass;
class TInMemInstance;

/// A property's declaration in an in-memory class.
///
/// TInMemClass::AllocatePropertyDecl makes it; it gets its qualifiers and is added with TInMemClass::AddPropertyDecl. From then on
/// AddQualifier throws kClassInUse (19) if a Key that is not true would take a key away from a class with instances.
class CIMDELTA_EXPORT TInMemPropertyDecl : public TInMemNamedElement<ICIMPropertyDecl>,
                                           public boost::enable_shared_from_this<TInMemPropertyDecl> {
  public:
    /// The value gives type and default. A reference in it names the class that references point to; without keys it is no default.
    TInMemPropertyDecl(const std::string& name, const TCIMValue& value);

    const std::string& GetName(TCallContext context) const override;
    TCIMValue::TCIMType GetType(TCallContext context) const override;
    const TCIMValue& GetDefaultValue(TCallContext context) const override;

    const std::string& GetName() const noexcept { return fName; }
    TCIMValue::TCIMType GetType() const noexcept { return fDefault.GetType(); }
    const TCIMValue& GetDefaultValue() const noexcept { return fDefault; }

    /// The class that references point to; empty for other types, and if none was named.
    const std::string& GetReferenceClass() const noexcept { return fReferenceClass; }
    void SetReferenceClass(const std::string& name) { fReferenceClass = name; }
    /// The number of elements of a fixed array; 0 if it is not fixed.
    unsigned int GetArraySize() const noexcept { return fArraySize; }
    void SetArraySize(unsigned int size) noexcept { fArraySize = size; }

    bool IsKey() const noexcept { return fKey; }
    bool IsStatic() const noexcept { return fStatic; }
    /// Whether an array in it compares without regard to order: ArrayType "Bag" or none, and not OctetString.
    bool IsBag() const noexcept { return fBag; }
    /// Whether a null is replaced by the next number of the class when an instance is added: a uint64 key with Generated(true).
    bool IsGenerated() const noexcept { return fGenerated; }

    /// Whether text in it may be an embedded object: a string with EmbeddedObject(true) or EmbeddedInstance. Cost: looks for both.
    bool HoldsObjects() const;

    /// The value as the property holds it: nulls typed, bags marked. Errors: kTypeMismatch (13) if the types differ; the
    /// TStoreRefusal names the property and `holder`, whose property it is, or for null the declaring class.
    TCIMValue Fit(TCIMValue value, const TInMemInstance* holder = nullptr) const;

    /// The value with a stub in the place of each class that a reference in it holds, in keys, elements and embedded objects too. A
    /// class owns its declarations; if a value in one of them owned the class, neither would ever be released.
    static TCIMValue WithoutClasses(TCIMValue value);

    /// Writes the default another way, such as a reference without its namespace. A static property that still has the default gets
    /// the new one. `value` must be of the declared type.
    void RewriteDefault(const TCIMValue& value);

    /// Spells the name another way. Errors: kInvalidParameter (5) if more than letter case differs.
    void SetSpelling(const std::string& name);

    /// The declaration of an ancestor that this one overrides, from which it inherits qualifiers; null for none.
    const boost::shared_ptr<TInMemPropertyDecl>& GetOverridden() const noexcept { return fOverridden; }
    void SetOverridden(boost::shared_ptr<TInMemPropertyDecl> overridden);
    /// Whether this declaration, or one that it overrides, has the qualifier Key(true) if `other` is left out of account.
    bool IsKeyWithout(const TInMemPropertyDecl& other) const;

    /// The class that declares it; null before it is added to one, and if that class is gone.
    boost::shared_ptr<TInMemClass> GetOwner() const { return fOwner.lock(); }
    void SetOwner(boost::weak_ptr<TInMemClass> owner) noexcept { fOwner.swap(owner); }

    /// The one value of a property with the qualifier Static; an ordinary property's is null and of no use.
    TInMemStaticProperty& GetStaticProperty() noexcept { return fStaticProperty; }

  private:
    void PutQualifier(boost::shared_ptr<ICIMQualifier> qualifier) override;
    void UpdateMarks();
    void MarkStaticValue();
    bool IsBagDeclared() const;
    [[noreturn]] void RefuseType(TCIMValue::TCIMType type, const TInMemInstance* holder) const;

    std::string fName;
    std::string fReferenceClass;
    TCIMValue fDefault;
    unsigned int fArraySize = 0;
    bool fKey = false;
    bool fStatic = false;
    bool fBag = false;
    bool fGenerated = false;
    boost::shared_ptr<TInMemPropertyDecl> fOverridden;
    boost::weak_ptr<TInMemClass> fOwner;  // the class it has been added to
    TInMemStaticProperty fStaticProperty;
};

}  // namespace NORVZEL20
