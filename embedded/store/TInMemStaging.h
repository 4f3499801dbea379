#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <unordered_map>
#include <vector>

#include "embedded/store/TInMemExtent.h"
#include "embedded/store/TInMemNamespace.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// Adds many things to a namespace, all of them or none.
///
/// What is added is visible at once. Unless Commit is called, the destructor takes everything out again, and the namespace is as it
/// was, generated numbers included. While a staging is open, remove nothing and change no class that was there before; static
/// values may change if KeepStaticValues was called first.
/// Threads: as the namespace.
class CIMDELTA_INTERNAL_EXPORT TInMemStaging {
  public:
    /// `ns` must not be null.
    explicit TInMemStaging(boost::shared_ptr<TInMemNamespace> ns) noexcept;
    TInMemStaging(const TInMemStaging&) = delete;
    TInMemStaging& operator=(const TInMemStaging&) = delete;
    ~TInMemStaging();

    /// After an error of the following three operations the staging may still be used; what failed is not added.
    /// Errors: kAlreadyExists (12) if one of that name is declared.
    void AddQualifierDecl(const boost::shared_ptr<TInMemQualifierDecl>& decl);
    /// Adds a class allocated from the namespace. Errors: kAlreadyExists (12), kTypeMismatch (13), kNotFound (15) if its superclass
    /// is not declared.
    void AddClass(const boost::shared_ptr<TInMemClass>& cls);
    /// Errors: kAlreadyExists (12) if one with the same keys is there (TInMemInstance::GetReference gives its path), kKeyMissing
    /// (14) if a key is null (TInMemInstance::FindMissingKey gives its name), kNotFound (15) if the class is not declared.
    void AddInstance(const boost::shared_ptr<TInMemInstance>& instance);

    /// Notes the values of the class's static properties, to be put back unless Commit is called. Call this before the instances of
    /// a class are filled, because setting a static property of an instance changes it for the class.
    void KeepStaticValues(const TInMemClass& cls);

    /// Keeps everything that was added.
    void Commit() noexcept;

  private:
    struct TStaticValue {
        boost::shared_ptr<TInMemPropertyDecl> decl;
        TInMemStaticProperty::TState state;
    };

    TInMemExtent& GetMarkedExtent(TInMemClass& cls);

    boost::shared_ptr<TInMemNamespace> fNamespace;
    std::vector<boost::shared_ptr<TInMemQualifierDecl>> fQualifierDecls;
    std::vector<boost::shared_ptr<TInMemClass>> fClasses;
    std::unordered_map<TInMemExtent*, TInMemExtent::TMark> fExtents;            // marks from before the first instance was added
    std::unordered_map<const TInMemPropertyDecl*, TStaticValue> fStaticValues;  // as they were before
    TInMemExtent* fLast = nullptr;                                              // the one used last, which is in fExtents
    bool fCommitted = false;
};

}  // namespace NORVZEL20
