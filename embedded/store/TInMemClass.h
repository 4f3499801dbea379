#pragma once

#include <boost/smart_ptr/enable_shared_from_this.hpp>
#include <boost/smart_ptr/weak_ptr.hpp>
#include <string>
#include <string_view>
#include <vector>

#include "embedded/store/TInMemInstance.h"
#include "embedded/store/TInMemLayout.h"
#include "embedded/store/TInMemMethodSet.h"
#include "embedded/store/TInMemNamedElement.h"
#include "embedded/store/TInMemPages.h"
#include "host/Export.h"
#include "host/ICIMClass.h"

namespace NORVZEL20 {

class TInMemExtent;
class TInMemNamespace;

/// A class of an in-memory namespace.
///
/// It keeps the layout of its instances (TInMemLayout), its methods (TInMemMethodSet) and its qualifiers. It holds its superclass.
/// Its namespace, its subclasses, its instances and the references to it hold it. After the namespace is gone, operations that
/// need it throw kNamespaceGone (18); the others work as before.
/// A change of properties reaches all classes below. It finds the memory for that first; if that fails, nothing has changed.
/// Comparison operators compare names without regard to letter case; assignment takes nothing over.
/// Threads: as the namespace.
class CIMDELTA_EXPORT TInMemClass final : public TInMemNamedElement<ICIMClass>, public boost::enable_shared_from_this<TInMemClass> {
  public:
    /// A class that is not visible yet; `superClass` is null for a top-level class. For TInMemNamespace::AllocateInMemClass, which
    /// checks the arguments.
    static boost::shared_ptr<TInMemClass> Create(const boost::shared_ptr<TInMemNamespace>& ns, const std::string& name,
                                                 boost::shared_ptr<TInMemClass> superClass);
    TInMemClass(const TInMemClass&) = delete;

    /// Checks that AddToNamespace would succeed. Errors: those of AddToNamespace.
    void Validate(TCallContext context) const override;
    /// Errors: kAlreadyExists (12) if the name is taken, kTypeMismatch (13) if the superclass has got one of its properties with
    /// another type, kNotFound (15) if the superclass is not declared, kNamespaceGone (18).
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
    /// Errors: kInvalidParameter (5) for an empty name, kTypeMismatch (13) for a value without a type.
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
    /// AddToNamespace of a class that was allocated below this one. Errors: kInvalidParameter (5) if it was not.
    bool AddChildClass(boost::shared_ptr<ICIMClass> cls) override;
    bool RemoveChildClass(boost::shared_ptr<ICIMClass> cls) override;
    /// False also if another instance has those keys. Errors: kInvalidParameter (5) if it is not of this class, kKeyMissing (14),
    /// kNotFound (15) if this class is not declared, kNamespaceGone (18).
    bool AddInstance(boost::shared_ptr<ICIMInstance> instance) override;
    bool RemoveInstance(boost::shared_ptr<ICIMInstance> instance) override;
    /// Names an association class beyond those whose references point to this class or an ancestor.
    bool AddAssociationClass(boost::shared_ptr<ICIMClass> cls) override;
    bool RemoveAssociationClass(boost::shared_ptr<ICIMClass> cls) override;
    /// Subclasses get the property too. A new key comes last among the keys of the class. A property of that name that an ancestor
    /// declares is overridden.
    /// Errors: kInvalidParameter (5) if `decl` does not come from AllocatePropertyDecl or is in a class, kTypeMismatch (13) if an
    /// ancestor or a class below declares the property with another type.
    bool AddPropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl) override;
    /// False for an inherited one. Errors: kClassInUse (19) if this class, or one below, has instances and would lose a key.
    bool RemovePropertyDecl(boost::shared_ptr<ICIMPropertyDecl> decl) override;
    bool AddMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl) override;
    bool RemoveMethodDecl(boost::shared_ptr<ICIMMethodDecl> decl) override;

    const std::string& GetName() const noexcept { return fName; }
    /// Whether that is the name of this class or of an ancestor.
    bool IsSubclassOf(std::string_view name) const noexcept;
    /// Null for a top-level class.
    const boost::shared_ptr<TInMemClass>& GetSuperInMemClass() const noexcept { return fSuper; }
    /// How many classes are above this one. Cost: in proportion to them.
    std::size_t CountSuperClasses() const noexcept;
    /// The direct subclasses in order of declaration.
    std::vector<boost::shared_ptr<TInMemClass>> GetSubClasses() const;
    /// All classes below this one, each before its own subclasses.
    std::vector<boost::shared_ptr<TInMemClass>> GetClassesBelow() const;
    /// Null if the namespace is gone.
    boost::shared_ptr<TInMemNamespace> GetInMemNamespace() const { return fNamespace.lock(); }
    /// The namespace's name, also when it is gone.
    const std::string& GetNamespaceName() const noexcept { return fNamespaceName; }
    /// Whether it is visible in a namespace that lives.
    bool IsDeclared() const noexcept { return fExtent != nullptr; }

    /// The properties, their slots, their order and the keys.
    const TInMemLayout& GetLayout() const noexcept { return fLayout; }
    const TInMemMethodSet& GetMethods() const noexcept { return fMethods; }
    /// The declaration of a property, own or inherited; null if there is none.
    boost::shared_ptr<TInMemPropertyDecl> FindPropertyDecl(std::string_view name) const { return fLayout.FindDecl(name); }
    /// Whether AddAssociationClass has named that class.
    bool IsAssociatedBy(const TInMemClass& association) const noexcept;

    /// The instances of exactly this class. Errors: kNotFound (15) if it is not declared, kNamespaceGone (18).
    TInMemExtent& GetExtent() const;
    /// As TInMemExtent::ShareRecent; nothing if the class is not declared.
    void ShareRecent(std::uint32_t slot, TCIMValue& value) const;
    /// How many there are; 0 if the class is not declared.
    std::size_t GetInstanceCount() const noexcept;
    /// A new instance with every property null, at most one allocation. Its memory is part of a TInMemPage.
    boost::shared_ptr<TInMemInstance> AllocateInMemInstance();
    /// Where they get their memory.
    TInMemPages& GetPages() noexcept { return fPages; }

    /// Runs `change`, which changes the qualifiers of a property that this class itself declares, and brings this class and those
    /// below in line. Whatever `change` throws is passed on, and then nothing has changed.
    void ChangeProperty(const TInMemPropertyDecl& decl, const boost::function<void()>& change);
    /// Spells the name another way. Errors: kInvalidParameter (5) if more than letter case differs.
    void SetSpelling(const std::string& name);

  private:
    friend class TInMemNamespace;  // the owner: it alone puts the class in and takes it out

    TInMemClass(const boost::shared_ptr<TInMemNamespace>& ns, const std::string& name, boost::shared_ptr<TInMemClass> superClass);

    /// Becomes visible below `parent`, with `extent` to hold its instances. Errors: std::bad_alloc, and then it is not.
    void Enter(TInMemClass& parent, TInMemExtent& extent);
    void Leave(TInMemClass& parent) noexcept;
    void NamespaceGoes() noexcept { fExtent = nullptr; }

    boost::shared_ptr<TInMemNamespace> RequireNamespace() const;
    std::vector<boost::shared_ptr<TInMemClass>> GetReservedClassesBelow();
    void MethodChanged(std::string_view name);

    std::string fName;
    std::string fNamespaceName;
    boost::shared_ptr<TInMemClass> fSuper;
    boost::weak_ptr<TInMemNamespace> fNamespace;
    TInMemExtent* fExtent = nullptr;  // the namespace's; null while the class is not declared there
    std::vector<boost::weak_ptr<TInMemClass>> fSubClasses;
    std::vector<boost::weak_ptr<TInMemClass>> fAssociations;  // added by AddAssociationClass
    TInMemLayout fLayout;
    TInMemMethodSet fMethods;
    TInMemPages fPages;
};

}  // namespace NORVZEL20
