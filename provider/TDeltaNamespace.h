#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/enable_shared_from_this.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <map>
#include <string>
#include <vector>

#include "host/Export.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

class TDeltaClass;

/// A namespace that compares other namespaces and holds what differs as instances. Start here.
///
///     ns->SetSpecFileName("rules.xml");
///     ns->AddNamespaceToCompareList(reference);
///     ns->AddNamespaceToCompareList(other);
///     ns->FindDifferences();
///     ns->ExecuteQuery(callback, language, query, TCallContext());   // select * from KALMO_Delta
///
/// Instances, and the classes of the delta schema, come from a store of its own. Any other class is that of a compared namespace,
/// chosen by the call context's "nsIndex" and wrapped as a TDeltaClass, so that whatever is reached through it stays inside this
/// namespace. The schema cannot be changed: such requests are refused with status 31.
///
/// Made by TDeltaNamespaceProvider::AllocateNamespace and owned by shared pointers. A wrapper keeps its delta namespace alive and
/// the namespace keeps its wrappers: once a wrapped class was asked for, both live until the process ends.
/// Threads: one at a time; a run must not overlap any other call.
/// Errors: TZELException with the status that each operation names, and the exceptions of the host's objects as they are. A null
/// pointer where a namespace is needed fails the host's assertion "px != 0". The order of the virtual operations is part of the
/// contract.
class CIMDELTA_EXPORT TDeltaNamespace : public ICIMNamespace, public boost::enable_shared_from_this<TDeltaNamespace> {
  public:
    /// What a difference record (KALMO_Delta) tells, as its property "Type".
    enum EDeltaType {
        kInstanceRemoved = 1,  ///< the reference has an instance that the listed namespaces lack
        kInstanceAdded = 2,    ///< the listed namespaces have an instance that the reference lacks
        kPropertyChanged = 4   ///< one property of an instance has another value in the listed namespaces
    };

    /// Allocates the store from the host's "inmem" provider and loads the delta schema into it: the file
    /// "deltaclasses.properties.xml" in the folder "data" below the host's root.
    /// Errors: those of provider and populator; a missing provider fails the host's assertion.
    TDeltaNamespace();

    /// A namespace without a store, and with nothing else either: the argument is ignored. Whatever needs the store fails the
    /// host's assertion.
    explicit TDeltaNamespace(boost::shared_ptr<const ICIMNamespace> ignored);

    TDeltaNamespace(const TDeltaNamespace&) = delete;

    /// Releases the store, the compared namespaces and the wrappers. Nothing is written back.
    ~TDeltaNamespace() override;

    /// Does nothing; the provider calls it once the namespace is owned by a shared pointer.
    void Initialize();

    /// Names the specification file of the runs to come; a text that contains "|fVMWareEnable" makes them go without rules.
    ///
    /// The name is not looked at before a run: an empty one, or that of a missing file, is accepted here.
    void SetSpecFileName(std::string name);

    /// Adds `ns` at the next position of the compare list; the first one added is the reference.
    ///
    /// Null and repeated namespaces are taken as they are. Positions never change afterwards.
    /// Errors: std::bad_alloc only.
    void AddNamespaceToCompareList(boost::shared_ptr<ICIMNamespace> ns);

    /// The number of namespaces in the compare list, cut to 16 bits.
    unsigned short NumContainers() const;

    /// Compares the namespaces of the compare list and adds what differs to the store: a KALMO_DeltaClass for each class with
    /// differences, and for each difference a KALMO_Delta and a KALMO_DeltaClassAssocToDelta.
    ///
    /// With exactly two namespaces the reference is changed on the way: it takes over the other one's values, and gets a copy of
    /// each instance that only the other one has. Runs may be repeated; their records accumulate.
    /// Errors: boost::bad_weak_ptr where this namespace is not owned by a shared pointer, before anything else; TZELException
    /// with the statuses of TCIMDiffEngine. Records written before a failure stay.
    void FindDifferences();

    /// The context's "nsIndex", which is below NumContainers().
    ///
    /// Errors: status 38 where the context has none; status 15 where it is too large, after one line on standard output; the
    /// host's error for a value that does not convert to `unsigned short`.
    unsigned short GetDiffIndex(TCallContext context) const;

    /// The provider "delta".
    boost::shared_ptr<INamespaceProvider> GetNamespaceProvider(TCallContext context) const override;
    /// Refused with status 31.
    void SetUpcallNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context) override;
    /// Refused with status 31.
    void AddUnderlyingNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context) override;
    /// Refused with status 31.
    boost::shared_ptr<ICIMClass> AllocateClass(const std::string& name, boost::shared_ptr<ICIMClass> superClass,
                                               TCallContext context) override;

    /// The store's class of that name, or else the wrapper of the one in the compared namespace that "nsIndex" selects.
    ///
    /// A wrapper is made once for each position and spelling of the name, so that the same request gives the same object. A class
    /// of the store is not wrapped and needs no "nsIndex".
    /// Errors: as GetDiffIndex where the store lacks the class; any other status of the store; those of the compared namespace;
    /// boost::bad_weak_ptr where a wrapper is due and this namespace is not owned by a shared pointer.
    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext context) override;

    /// Refused with status 31.
    void EnumerateRootClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback, TCallContext context) override;
    /// Refused with status 31.
    void EnumerateProviders(const boost::function<bool(boost::shared_ptr<IProvider>)>& callback, TCallContext context) override;
    /// Refused with status 31.
    boost::shared_ptr<ICIMQualifierDecl> AllocateQualifierDecl(const std::string& name, const TCIMValue& value,
                                                               ICIMQualifierDecl::EScope scope, ICIMQualifierDecl::EFlavor flavor,
                                                               TCallContext context) override;

    /// The declaration of the compared namespace that "nsIndex" selects. Errors: as GetDiffIndex; those of that namespace.
    boost::shared_ptr<ICIMQualifierDecl> GetQualifierDecl(const std::string& name, TCallContext context) const override;
    /// The declarations of the compared namespace that "nsIndex" selects. Errors: as GetQualifierDecl.
    void EnumerateQualifierDecls(const boost::function<bool(boost::shared_ptr<ICIMQualifierDecl>)>& callback,
                                 TCallContext context) const override;

    /// Not offered: status 1.
    void Subscribe(boost::shared_ptr<ICIMIndicationFilter> filter,
                   const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, TCallContext context) override;

    /// The store's operations, on the records of every run so far. Errors: the store's.
    boost::shared_ptr<ICIMInstance> GetInstance(const TCIMReference& path, TCallContext context) const override;
    void DeleteInstance(const TCIMReference& path, TCallContext context) override;
    void ModifyInstance(const TCIMReference& path, TCallContext properties, TCallContext context) override;
    void ExecuteQuery(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, std::string& language,
                      std::string& query, TCallContext context) override;

    /// Does nothing: the records stay. A new namespace is the only empty one.
    void ClearInstances() override;

    /// Copies nothing.
    ICIMNamespace& operator=(ICIMNamespace& other) override;
    TDeltaNamespace& operator=(const TDeltaNamespace& other);

  private:
    boost::shared_ptr<ICIMClass> GetWrappedClass(const std::string& name, const TCallContext& context);

    std::string fSpecFileName;
    std::vector<std::map<std::string, boost::shared_ptr<TDeltaClass>>> fClassCache;  // one map for each entry of fCompareList
    std::vector<boost::shared_ptr<ICIMNamespace>> fCompareList;
    boost::shared_ptr<ICIMNamespace> fDeltaStore;
};

}  // namespace NORVZEL20
