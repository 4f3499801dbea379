#pragma once

#include <boost/smart_ptr/enable_shared_from_this.hpp>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "embedded/store/TInMemClass.h"
#include "embedded/store/TInMemQualifierDecl.h"
#include "embedded/value/ILocated.h"
#include "embedded/value/TNameText.h"
#include "host/Export.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// A namespace that holds classes, qualifier declarations and instances in memory.
///
/// Owns its classes and instances; handles that outlive it stay valid (see TInMemClass and TInMemInstance). To load many things and
/// take them back where one fails, use TInMemStaging. Assignment takes nothing over.
/// Threads: one at a time for each namespace; different namespaces may be used at once.
class CIMDELTA_EXPORT TInMemNamespace final : public ICIMNamespace,
                                              public ILocated,
                                              public boost::enable_shared_from_this<TInMemNamespace> {
  public:
    /// An empty namespace of that name; slashes in front and behind are taken off.
    static boost::shared_ptr<TInMemNamespace> Create(const std::string& name);
    TInMemNamespace(const TInMemNamespace&) = delete;
    ~TInMemNamespace() override;

    const std::string& GetNamespaceName() const override;

    boost::shared_ptr<INamespaceProvider> GetNamespaceProvider(TCallContext context) const override;
    void SetUpcallNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context) override;
    void AddUnderlyingNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context) override;
    /// `superClass` must be a class of this namespace, else status 5; "<root>" stands for none.
    boost::shared_ptr<ICIMClass> AllocateClass(const std::string& name, boost::shared_ptr<ICIMClass> superClass,
                                               TCallContext context) override;
    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext context) override;
    void EnumerateRootClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback, TCallContext context) override;
    /// There are none.
    void EnumerateProviders(const boost::function<bool(boost::shared_ptr<IProvider>)>& callback, TCallContext context) override;
    boost::shared_ptr<ICIMQualifierDecl> AllocateQualifierDecl(const std::string& name, const TCIMValue& value,
                                                               ICIMQualifierDecl::EScope scope, ICIMQualifierDecl::EFlavor flavor,
                                                               TCallContext context) override;
    boost::shared_ptr<ICIMQualifierDecl> GetQualifierDecl(const std::string& name, TCallContext context) const override;
    void EnumerateQualifierDecls(const boost::function<bool(boost::shared_ptr<ICIMQualifierDecl>)>& callback,
                                 TCallContext context) const override;
    /// Status 1: there are no indications.
    void Subscribe(boost::shared_ptr<ICIMIndicationFilter> filter,
                   const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, TCallContext context) override;
    /// The path's class and keys count, its namespace and host do not. Key values are converted to the declared types where
    /// nothing is lost by it, so that a path read from text finds what it names.
    boost::shared_ptr<ICIMInstance> GetInstance(const TCIMReference& path, TCallContext context) const override;
    void DeleteInstance(const TCIMReference& path, TCallContext context) override;
    void ModifyInstance(const TCIMReference& path, TCallContext properties, TCallContext context) override;
    /// Answers WQL, with the whole instances (see TQuery). Errors: TQueryError.
    void ExecuteQuery(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, std::string& language,
                      std::string& query, TCallContext context) override;
    /// Removes all instances; classes stay.
    void ClearInstances() override;
    ICIMNamespace& operator=(ICIMNamespace& other) override;
    TInMemNamespace& operator=(const TInMemNamespace& other) = delete;

    /// The class of that name, or null; "<root>" is none of them.
    boost::shared_ptr<TInMemClass> FindClass(std::string_view name) const;
    /// As AllocateClass.
    boost::shared_ptr<TInMemClass> AllocateInMemClass(const std::string& name, boost::shared_ptr<TInMemClass> superClass);
    /// All classes in order of declaration, superclasses before their subclasses.
    const std::vector<boost::shared_ptr<TInMemClass>>& GetClasses() const noexcept { return fClasses; }
    /// Null where there is none.
    boost::shared_ptr<TInMemQualifierDecl> FindQualifierDecl(std::string_view name) const;
    const std::vector<boost::shared_ptr<TInMemQualifierDecl>>& GetQualifierDecls() const noexcept { return fQualifierDecls; }
    /// Errors: status 12 where one of that name is declared.
    void AddQualifierDecl(boost::shared_ptr<TInMemQualifierDecl> decl);
    /// Finds instances anew by keys that hold references, whose paths change with the spelling of a class and its keys.
    void ReferenceTextsChanged();
    /// The instance of that path, or null where there is none or no such class. Errors: status 13, 14.
    boost::shared_ptr<TInMemInstance> FindInstance(const TCIMReference& path) const;

  private:
    friend class TInMemClass;
    friend class TInMemStaging;

    explicit TInMemNamespace(const std::string& name);

    struct TEntry {
        boost::shared_ptr<TInMemClass> cls;
        std::unique_ptr<TInMemExtent> extent;
    };

    boost::shared_ptr<TInMemInstance> RequireInstance(const TCIMReference& path) const;
    void CheckNew(const TInMemClass& cls) const;
    void Declare(const boost::shared_ptr<TInMemClass>& cls);
    void Withdraw(TInMemClass& cls) noexcept;
    void Withdraw(const TInMemQualifierDecl& decl) noexcept;
    /// The class above `cls`, "<root>" for a top-level class.
    TInMemClass& GetParent(const TInMemClass& cls) const noexcept;

    std::string fName;
    boost::shared_ptr<TInMemClass> fRoot;  // "<root>": its subclasses are the top-level classes
    std::vector<boost::shared_ptr<TInMemClass>> fClasses;
    TNameHashMap<TEntry> fClassesByName;
    std::vector<boost::shared_ptr<TInMemQualifierDecl>> fQualifierDecls;
    TNameHashMap<boost::shared_ptr<TInMemQualifierDecl>> fQualifierDeclsByName;
};

}  // namespace NORVZEL20
