#pragma once

#include <boost/smart_ptr/enable_shared_from_this.hpp>
#include <boost/smart_ptr/weak_ptr.hpp>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "embedded/store/THashIndex.h"
#include "embedded/store/TInMemInstance.h"
#include "embedded/store/TInMemMethodDecl.h"
#include "embedded/store/TInMemNamedElement.h"
#include "embedded/store/TInMemPropertyDecl.h"
#include "host/Export.h"
#include "host/ICIMClass.h"

namespace NORVZEL20 {

class TInMemExtent;
class TInMemNamespace;

/// A class of an in-memory namespace.
///
/// Lays out its instances: each property has a slot, inherited ones first; a property that comes later gets the next free slot,
/// and the slot of a removed one stays unused. Holds its superclass; is held by its namespace, its subclasses, its instances and
/// the references to it. Where the namespace is gone, its operations work as far as they need none; the others throw status 18.
/// Comparison operators compare names without regard to letter case; assignment takes nothing over.
class CIMDELTA_EXPORT TInMemClass final : public TInMemNamedElement<ICIMClass>, public boost::enable_shared_from_this<TInMemClass> {
  public:
    static constexpr std::uint32_t kNoSlot = 0xffffffff;

    /// A class that is not visible yet; `superClass` null for a top-level class. TInMemNamespace::AllocateInMemClass calls it.
    static boost::shared_ptr<TInMemClass> Create(const boost::shared_ptr<TInMemNamespace>& ns, const std::string& name,
                                                 boost::shared_ptr<TInMemClass> superClass);
    TInMemClass(const TInMemClass&) = delete;

    /// Errors: status 12 where the name is taken, 13 where the superclass has got one of its properties with another type, 15 where
    /// the superclass is not declared, 18 where the namespace is gone.
    void Validate(TCallContext context) const override;
    void AddToNamespace(TCallContext context) override;
    void RemoveFromNamespace(TCallContext context) override;
    void ModifyClass(boost::shared_ptr<ICIMClass> cls, TCallContext context) override;
    const std::string& GetName(TCallContext context) const override;
    boost::shared_ptr<ICIMNamespace> GetNamespace(TCallContext context) const override;
    bool IsAssociation(TCallContext context) const override;
    bool IsAbstract(TCallContext context) const override;
    bool IsRootClass(TCallContext context) const override;
    boost::shared_ptr<ICIMClass> GetSuperClass(TCallContext context) const override;
    void EnumerateSubClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback, bool deep,
                             TCallContext context) override;
    bool IsSubclassOf(boost::shared_ptr<const ICIMClass> cls, TCallContext context) const override;
    void EnumerateAssociatedClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                    const std::string& associationClass, const std::string& resultClass, const std::string& role,
                                    const std::string& resultRole, TCallContext context) override;
    void EnumerateAssociationClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback,
                                     const std::string& resultClass, const std::string& role, TCallContext context) override;
    void EnumerateKeyNames(const boost::function<bool(const std::string*)>& callback, TCallContext context) const override;
    /// Errors: also status 5 for an empty name, 13 for a value without a type.
    boost::shared_ptr<ICIMPropertyDecl> AllocatePropertyDecl(const std::string& name, const TCIMValue& value,
                                                             TCallContext context) override;
    boost::shared_ptr<ICIMPropertyDecl> GetPropertyDecl(const std::string& name, TCallContext context) const override;
    void EnumeratePropertyDecls(const boost::function<bool(boost::shared_ptr<ICIMPropertyDecl>)>& callback,
                                TCallContext context) const override;
    boost::shared_ptr<ICIMProperty> GetProperty(const std::string& name, TCallContext context) override;
    void SetPropertyValue(const std::string& name, const TCIMValue& value, TCallContext context) override;
    void EnumerateStaticProperties(const boost::function<bool(boost::shared_ptr<ICIMProperty>)>& callback,
                                   TCallContext context) override;
    boost::shared_ptr<ICIMInstance> AllocateInstance(TCallContext context) override;
    void EnumerateInstances(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, bool deep,
                            TCallContext context) override;
    boost::shared_ptr<ICIMMethodDecl> AllocateMethodDecl(const std::string& name, TCIMValue::TCIMType type,
                                                         TCallContext context) override;
    boost::shared_ptr<ICIMMethodDecl> GetMethodDecl(const std::string& name, TCallContext context) const override;
    void EnumerateMethodDecls(const boost::function<bool(boost::shared_ptr<ICIMMethodDecl>)>& callback,
                              TCallContext context) const override;
    TCIMValue InvokeMethod(const std::string& name, TCallContext& parameters, TCallContext context) override;
    bool operator==(ICIMClass& other) const override;
    bool operator<(ICIMClass& other) const override;
    ICIMClass& operator=(const ICIMClass& other) override;
    TInMemClass& operator=(const TInMemClass& other);
    /// AddToNamespace of a class that was allocated below this one. Errors: status 5 where it was not.
    bool AddChildClass(boost::shared_ptr<ICIMClass> cls) override;
    bool RemoveChildClass(boost::shared_ptr<ICIMClass> cls) override;
    /// False also where another instance has those keys. Errors: status 5 where it is not of this class, 14, 18.
    bool AddInstance(boost::shared_ptr<ICIMInstance> instance) override;
    bool RemoveInstance(boost::shared_ptr<ICIMInstance> instance) override;
    /// Names an association class beyond those whose references point to this class or an ancestor.
    bool AddAssociationClass(boost::shared_ptr<ICIMClass> cls) override;
    bool RemoveAssociationClass(boost::shared_ptr<ICIMClass> cls) override;
    /// `decl` must come from AllocatePropertyDecl and be in no class yet, else status 5. One that an ancestor declares is
    /// overridden by it: status 13 where the types differ. Subclasses get the property too. A key comes last among the keys.
    bool AddPropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl) override;
    /// False for an inherited one. Errors: status 19 where this class, or one below, has instances and would lose a key.
    bool RemovePropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl) override;
    bool AddMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl) override;
    bool RemoveMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl) override;

    /// As the operations above, without context.
    const std::string& GetName() const noexcept { return fName; }
    bool IsAssociation() const { return GetQualifiers().IsTrueAnywhere("Association"); }
    bool IsAbstract() const;
    bool IsSubclassOf(std::string_view name) const noexcept;
    /// Null for a top-level class.
    const boost::shared_ptr<TInMemClass>& GetSuperInMemClass() const noexcept { return fSuper; }
    /// How many classes are above this one. Cost: in proportion to them.
    std::size_t CountSuperClasses() const noexcept;
    /// The direct subclasses in order of declaration.
    std::vector<boost::shared_ptr<TInMemClass>> GetSubClasses() const;
    /// All classes below this one, each before its own subclasses.
    std::vector<boost::shared_ptr<TInMemClass>> GetClassesBelow() const;
    /// Null where the namespace is gone.
    boost::shared_ptr<TInMemNamespace> GetInMemNamespace() const { return fNamespace.lock(); }
    /// The namespace's name, also when it is gone.
    const std::string& GetNamespaceName() const noexcept { return fNamespaceName; }
    /// Whether it is visible in a namespace that lives.
    bool IsDeclared() const noexcept { return fExtent != nullptr; }
    /// What this class itself declares or overrides, in order.
    const std::vector<boost::shared_ptr<TInMemPropertyDecl>>& GetOwnPropertyDecls() const noexcept { return fOwn; }
    const std::vector<boost::shared_ptr<TInMemMethodDecl>>& GetOwnMethodDecls() const noexcept { return fMethods; }

    /// The layout. A slot stays the same as long as the class lives; slots and order of declaration differ.
    std::uint32_t FindSlot(std::string_view name) const noexcept;  ///< kNoSlot where there is no such property
    std::uint32_t GetSlotCount() const noexcept { return static_cast<std::uint32_t>(fSlots.size()); }
    const TInMemPropertyDecl& GetSlotDecl(std::uint32_t slot) const noexcept { return *fSlots[slot]; }
    const boost::shared_ptr<TInMemPropertyDecl>& GetSharedSlotDecl(std::uint32_t slot) const noexcept { return fSlots[slot]; }
    /// The slots of all properties in order of declaration, inherited ones first.
    const std::vector<std::uint32_t>& GetSlotOrder() const noexcept { return fOrder; }
    /// The slots of the keys, in that order.
    const std::vector<std::uint32_t>& GetKeySlots() const noexcept { return fKeySlots; }

    /// Null where there is none, own or inherited.
    boost::shared_ptr<TInMemPropertyDecl> FindPropertyDecl(std::string_view name) const;
    boost::shared_ptr<TInMemMethodDecl> FindMethodDecl(std::string_view name) const;

    /// A new instance with every property null, one allocation.
    boost::shared_ptr<TInMemInstance> AllocateInMemInstance();
    /// The number of instances of exactly this class; 0 where it is not declared.
    std::size_t GetInstanceCount() const noexcept;

    /// Spells the name another way. Errors: status 5 where more than letter case differs.
    void SetSpelling(const std::string& name);

  private:
    friend class TInMemNamespace;
    friend class TInMemInstance;
    friend class TInMemPropertyDecl;
    friend class TInMemStaging;

    explicit TInMemClass(const std::string& name);

    boost::shared_ptr<TInMemNamespace> RequireNamespace() const;
    TInMemExtent& GetExtent() const;
    TCIMReference MakePath() const;
    void CheckKeyStays(const TInMemPropertyDecl& decl) const;
    bool IsPseudoClass() const noexcept;

    boost::shared_ptr<TInMemPropertyDecl> FindOwnDecl(std::string_view name) const;
    boost::shared_ptr<TInMemMethodDecl> FindOwnMethod(std::string_view name) const;
    void InheritSlots();
    void InheritDecl(std::string_view name);
    void AppendSlot(const boost::shared_ptr<TInMemPropertyDecl>& decl);
    void TakeIn(const boost::shared_ptr<TInMemPropertyDecl>& decl, std::size_t position);
    void CheckOverrides(const TInMemPropertyDecl& decl) const;
    void ReserveSlot();
    std::vector<boost::shared_ptr<TInMemClass>> PrepareChange();
    void DeclChanged(const TInMemPropertyDecl& decl, const std::vector<boost::shared_ptr<TInMemClass>>& below);
    void MethodChanged(std::string_view name);
    void UpdateLayout();
    void UpdateOrder();
    void UpdateKeys();

    bool RefersTo(const TInMemClass& cls, std::string_view role) const;
    std::vector<boost::shared_ptr<TInMemClass>> FindAssociationClasses(const std::string& resultClass,
                                                                       const std::string& role) const;
    void AddOtherEnds(const TInMemClass& association, const std::string& role, const std::string& resultRole,
                      const std::string& resultClass, std::vector<boost::shared_ptr<TInMemClass>>& ends) const;

    std::string fName;
    std::string fNamespaceName;
    boost::shared_ptr<TInMemClass> fSuper;
    boost::weak_ptr<TInMemNamespace> fNamespace;
    TInMemExtent* fExtent = nullptr;  // the namespace's; null while the class is not declared there
    std::vector<boost::weak_ptr<TInMemClass>> fSubClasses;
    std::vector<boost::weak_ptr<TInMemClass>> fAssociations;  // added by AddAssociationClass
    std::vector<boost::shared_ptr<TInMemPropertyDecl>> fOwn;
    std::vector<boost::shared_ptr<TInMemMethodDecl>> fMethods;
    std::vector<boost::shared_ptr<TInMemPropertyDecl>> fSlots;  // that of a removed property keeps its declaration
    THashIndex fSlotIndex;
    std::vector<std::uint32_t> fOrder;
    std::vector<std::uint32_t> fKeySlots;
    std::uint32_t fLayout = 0;       // counts the changes of slots, order and keys
    std::uint32_t fSuperLayout = 0;  // the superclass's count when its slots were last taken over
};

}  // namespace NORVZEL20
