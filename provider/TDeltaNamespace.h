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
/// A request goes to one of two places:
/// - Instances, and the classes of the delta schema, come from a store of its own, which FindDifferences fills.
/// - Any other class, and every qualifier declaration, comes from the compared namespace that the call context's entry "nsIndex"
///   selects. Its classes are wrapped as TDeltaClass, so a client that walks from class to class stays in the delta namespace.
///
/// The namespace does not let its schema be changed: it refuses such requests with kNotSupported (31).
///
/// TDeltaNamespaceProvider::AllocateNamespace makes it and shared pointers own it. A wrapper keeps its delta namespace alive, and
/// the namespace keeps its wrappers: after the first request for a wrapped class, both live until the process ends.
/// Threads: use a delta namespace from one thread at a time.
/// Errors: TZELException with the status that each operation names, and the exceptions of the host's objects, unchanged. A null
/// namespace that is used fails the host's assertion "px != 0". The order of the virtual operations is part of the contract.
class CIMDELTA_EXPORT TDeltaNamespace : public ICIMNamespace, public boost::enable_shared_from_this<TDeltaNamespace> {
  public:
    /// The kind of a difference: the property "Type" of KALMO_Delta.
    enum EDeltaType {
        kInstanceRemoved = 1,  ///< the reference has an instance that the listed namespaces lack
        kInstanceAdded = 2,    ///< the listed namespaces have an instance that the reference lacks
        kPropertyChanged = 4   ///< one property of an instance has another value in the listed namespaces
    };

    /// Allocates the store from the host's "inmem" provider and loads the delta schema into it: the file
    /// "deltaclasses.properties.xml" in the folder "data" below the host's root.
    /// Errors: those of the provider and the populator; a missing provider fails the host's assertion.
    TDeltaNamespace();

    /// A namespace without a store. The argument is ignored. Operations that need the store fail the host's assertion.
    explicit TDeltaNamespace(boost::shared_ptr<const ICIMNamespace> ignored);

    TDeltaNamespace(const TDeltaNamespace&) = delete;

    /// Releases the store, the compared namespaces and the wrappers. Nothing is written back.
    ~TDeltaNamespace() override;

    /// Does nothing. The provider calls it as soon as a shared pointer owns the namespace.
    void Initialize();

    /// Sets the specification file of later runs. If the name contains "|fVMWareEnable", they run without rules.
    ///
    /// The name is not checked before a run: an empty name, or that of a missing file, is accepted here.
    void SetSpecFileName(std::string name);

    /// Adds `ns` at the next position of the compare list; the first one added is the reference.
    ///
    /// Null and repeated namespaces are accepted. Positions never change afterwards.
    /// Errors: std::bad_alloc only.
    void AddNamespaceToCompareList(boost::shared_ptr<ICIMNamespace> ns);

    /// The number of namespaces in the compare list, cut to 16 bits.
    unsigned short NumContainers() const;

    /// Compares the namespaces of the compare list and adds what differs to the store: a KALMO_DeltaClass for each class with
    /// differences, and for each difference a KALMO_Delta and a KALMO_DeltaClassAssocToDelta.
    ///
    /// With exactly two namespaces, the run changes the reference: it takes over the other namespace's values, and gets a copy of
    /// each instance that only the other namespace has. Runs may be repeated; their records accumulate.
    /// Errors: boost::bad_weak_ptr, before anything else, if no shared pointer owns this namespace; those of the rules and the
    /// comparison:
    /// - kInitializationFailed (3) if a namespace lacks KALMO_OperatingSystem, or the reference an instance of it with a numeric
    ///   OSType, or if there is no namespace
    /// - kOutOfMemory (4), kParseError (9), kFileError (11) if the specification file cannot be read or is wrong
    /// - kSchemaMismatch (37) if another namespace lacks a class of which the reference has instances
    /// - any other status of a compared namespace or the store
    ///
    /// Records written before an error stay.
    void FindDifferences();

    /// The value of the context's entry "nsIndex". It is less than NumContainers().
    ///
    /// Errors: kMissingParameter (38) if the context has no such entry; kNotFound (15), after one line on standard output, if the
    /// value is too large; the host's error if it does not convert to `unsigned short`.
    unsigned short GetDiffIndex(TCallContext context) const;

    /// The provider "delta".
    boost::shared_ptr<INamespaceProvider> GetNamespaceProvider(TCallContext context) const override;
    /// Refused with kNotSupported (31).
    void SetUpcallNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context) override;
    /// Refused with kNotSupported (31).
    void AddUnderlyingNamespace(boost::shared_ptr<ICIMNamespace> ns, TCallContext context) override;
    /// Refused with kNotSupported (31).
    boost::shared_ptr<ICIMClass> AllocateClass(const std::string& name, boost::shared_ptr<ICIMClass> superClass,
                                               TCallContext context) override;

    /// The store's class of that name. If the store has none, the wrapper of the class in the compared namespace that "nsIndex"
    /// selects.
    ///
    /// A wrapper is made once for each position and spelling of the name: the same request returns the same object. A class of the
    /// store is not wrapped and needs no "nsIndex".
    /// Errors: those of GetDiffIndex if the store has no such class; any other status of the store; those of the compared
    /// namespace; boost::bad_weak_ptr if a wrapper is to be made and no shared pointer owns this namespace.
    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext context) override;

    /// Refused with kNotSupported (31).
    void EnumerateRootClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>& callback, TCallContext context) override;
    /// Refused with kNotSupported (31).
    void EnumerateProviders(const boost::function<bool(boost::shared_ptr<IProvider>)>& callback, TCallContext context) override;
    /// Refused with kNotSupported (31).
    boost::shared_ptr<ICIMQualifierDecl> AllocateQualifierDecl(const std::string& name, const TCIMValue& value,
                                                               ICIMQualifierDecl::EScope scope, ICIMQualifierDecl::EFlavor flavor,
                                                               TCallContext context) override;

    /// The declaration of the compared namespace that "nsIndex" selects. Errors: those of GetDiffIndex and of that
    /// namespace.
    boost::shared_ptr<ICIMQualifierDecl> GetQualifierDecl(const std::string& name, TCallContext context) const override;
    /// The declarations of the compared namespace that "nsIndex" selects. Errors: as GetQualifierDecl.
    void EnumerateQualifierDecls(const boost::function<bool(boost::shared_ptr<ICIMQualifierDecl>)>& callback,
                                 TCallContext context) const override;

    /// Errors: kNotOffered (1), always.
    void Subscribe(boost::shared_ptr<ICIMIndicationFilter> filter,
                   const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, TCallContext context) override;

    /// These four work on the store, which holds the records of all runs. Errors: those of the store.
    boost::shared_ptr<ICIMInstance> GetInstance(const TCIMReference& path, TCallContext context) const override;
    void DeleteInstance(const TCIMReference& path, TCallContext context) override;
    void ModifyInstance(const TCIMReference& path, TCallContext properties, TCallContext context) override;
    void ExecuteQuery(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, std::string& language,
                      std::string& query, TCallContext context) override;

    /// Does nothing: the records stay. To start without records, allocate a new namespace.
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
