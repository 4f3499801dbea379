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
/// What is added shows at once. Unless Commit is called, the destructor takes everything out again, and the namespace is as it was,
/// generated numbers included; classes that were there must not be changed, except for static values that it was told to keep, and
/// nothing removed, while a staging is open.
/// Threads: as the namespace.
class CIMDELTA_INTERNAL_EXPORT TInMemStaging {
  public:
    /// `ns` must not be null.
    explicit TInMemStaging(boost::shared_ptr<TInMemNamespace> ns) noexcept;
    TInMemStaging(const TInMemStaging&) = delete;
    TInMemStaging& operator=(const TInMemStaging&) = delete;
    ~TInMemStaging();

    /// Errors: status 12 where one of that name is declared. After an error of these three the staging may go on.
    void AddQualifierDecl(const boost::shared_ptr<TInMemQualifierDecl>& decl);
    /// A class allocated from the namespace, its superclass declared. Errors: status 12, 13, 15.
    void AddClass(const boost::shared_ptr<TInMemClass>& cls);
    /// Errors: status 12 where one with the same keys is there (GetReference then tells its path), 14 where a key is null
    /// (FindMissingKey then tells its name), 15 where the class is not declared.
    void AddInstance(const boost::shared_ptr<TInMemInstance>& instance);

    /// Keeps the values of the class's static properties as they are now, which filling its instances changes.
    void KeepStaticValues(const TInMemClass& cls);

    void Commit() noexcept;

  private:
    struct TStaticValue {
        boost::shared_ptr<TInMemPropertyDecl> decl;
        TInMemStaticProperty::TState state;
    };

    TInMemExtent& Touch(TInMemClass& cls);

    boost::shared_ptr<TInMemNamespace> fNamespace;
    std::vector<boost::shared_ptr<TInMemQualifierDecl>> fQualifierDecls;
    std::vector<boost::shared_ptr<TInMemClass>> fClasses;
    std::unordered_map<TInMemExtent*, TInMemExtent::TMark> fExtents;            // those that got instances, as they were before
    std::unordered_map<const TInMemPropertyDecl*, TStaticValue> fStaticValues;  // as they were before
    TInMemExtent* fLast = nullptr;                                              // the extent of the last instance
    bool fCommitted = false;
};

}  // namespace NORVZEL20
