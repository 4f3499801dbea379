#pragma once

#include <boost/smart_ptr/enable_shared_from_this.hpp>
#include <map>
#include <string>
#include <vector>

#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

class TPlainClass;

/// The simplest possible namespace, independent of the embedded host. It keeps what it is given, in order, and checks nothing.
///
/// Unlike a real store it accepts several instances with the same keys, keys without a value, and values of another type than
/// declared. Names are compared byte for byte. Operations that no test needs throw kNotSupported (31).
class TPlainNamespace : public ICIMNamespace, public boost::enable_shared_from_this<TPlainNamespace> {
  public:
    static boost::shared_ptr<TPlainNamespace> Create(const std::string& name);
    /// Drops all instances, because instances and classes own each other.
    ~TPlainNamespace() override;

    const std::string& GetName() const { return fName; }
    boost::shared_ptr<TPlainClass> GetRoot() const { return fRoot; }
    void Add(boost::shared_ptr<TPlainClass> cls);

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
    explicit TPlainNamespace(const std::string& name);

    std::string fName;
    boost::shared_ptr<TPlainClass> fRoot;
    std::map<std::string, boost::shared_ptr<TPlainClass>> fClasses;
    std::vector<boost::shared_ptr<ICIMQualifierDecl>> fQualifierDecls;
};

}  // namespace NORVZEL20
