#pragma once

#include <string>

#include "host/ICIMNamespace.h"
#include "tests/support/watched/TCallWatch.h"

namespace NORVZEL20 {

/// A namespace that records its calls and those of all classes, instances and properties that it returns.
///
/// Wrappers of the delta namespace (TDeltaClass) are returned as they are, because their users downcast them.
class TWatchedNamespace : public ICIMNamespace {
  public:
    TWatchedNamespace(boost::shared_ptr<ICIMNamespace> ns, boost::shared_ptr<TCallWatch> watch, const std::string& label);

    boost::shared_ptr<ICIMNamespace> GetWatched() const { return fNamespace; }

    boost::shared_ptr<INamespaceProvider> GetNamespaceProvider(TCallContext context) const override;
    void SetUpcallNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context) override;
    void AddUnderlyingNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context) override;
    boost::shared_ptr<ICIMClass> AllocateClass(const std::string& name, boost::shared_ptr<ICIMClass> superClass,
                                               TCallContext context) override;
    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext context) override;
    void EnumerateRootClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback, TCallContext context) override;
    void EnumerateProviders(const boost::function<bool(boost::shared_ptr<IProvider>)>& callback, TCallContext context) override;
    boost::shared_ptr<ICIMQualifierDecl> AllocateQualifierDecl(const std::string& name, const TCIMValue& value,
                                                               ICIMQualifierDecl::EScope scope, ICIMQualifierDecl::EFlavor flavor,
                                                               TCallContext context) override;
    boost::shared_ptr<ICIMQualifierDecl> GetQualifierDecl(const std::string& name, TCallContext context) const override;
    void EnumerateQualifierDecls(const boost::function<bool(boost::shared_ptr<ICIMQualifierDecl>)>& callback,
                                 TCallContext context) const override;
    void Subscribe(boost::shared_ptr<ICIMIndicationFilter> filter,
                   const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, TCallContext context) override;
    boost::shared_ptr<ICIMInstance> GetInstance(const TCIMReference& path, TCallContext context) const override;
    void DeleteInstance(const TCIMReference& path, TCallContext context) override;
    void ModifyInstance(const TCIMReference& path, TCallContext properties, TCallContext context) override;
    void ExecuteQuery(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, std::string& language,
                      std::string& query, TCallContext context) override;
    void ClearInstances() override;
    ICIMNamespace& operator=(ICIMNamespace& other) override;

  private:
    boost::function<bool(boost::shared_ptr<ICIMClass>)>
    Watching(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback) const;
    boost::shared_ptr<ICIMClass> Watched(boost::shared_ptr<ICIMClass> cls) const;
    boost::shared_ptr<ICIMInstance> Watched(boost::shared_ptr<ICIMInstance> instance) const;

    boost::shared_ptr<ICIMNamespace> fNamespace;
    boost::shared_ptr<TCallWatch> fWatch;
    std::string fLabel;
};

}  // namespace NORVZEL20
