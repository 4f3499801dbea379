#include "tests/support/TTestAccess.h"

// TDeltaNamespace is an installed type, which names no friend. But the arguments of an explicit instantiation may name private
// members, so each instantiation below gives one of them to a function that only this file has.

namespace NORVZEL20 {

namespace {

template <class TType, TType TDeltaNamespace::*kMember, class TTag>
struct TRevealed {
    friend TType& Reveal(TTag, TDeltaNamespace& ns) { return ns.*kMember; }
};

using TWrapperMaps = std::vector<std::map<std::string, boost::shared_ptr<TDeltaClass>>>;
using TNamespaces = std::vector<boost::shared_ptr<ICIMNamespace>>;
using TStore = boost::shared_ptr<ICIMNamespace>;

struct TSpecFileNameTag {};
struct TClassCacheTag {};
struct TCompareListTag {};
struct TStoreTag {};

std::string& Reveal(TSpecFileNameTag, TDeltaNamespace& ns);
TWrapperMaps& Reveal(TClassCacheTag, TDeltaNamespace& ns);
TNamespaces& Reveal(TCompareListTag, TDeltaNamespace& ns);
TStore& Reveal(TStoreTag, TDeltaNamespace& ns);

template struct TRevealed<std::string, &TDeltaNamespace::fSpecFileName, TSpecFileNameTag>;
template struct TRevealed<TWrapperMaps, &TDeltaNamespace::fClassCache, TClassCacheTag>;
template struct TRevealed<TNamespaces, &TDeltaNamespace::fCompareList, TCompareListTag>;
template struct TRevealed<TStore, &TDeltaNamespace::fDeltaStore, TStoreTag>;

template <class TTag>
const auto& RevealConst(TTag tag, const TDeltaNamespace& ns)
{
    return Reveal(tag, const_cast<TDeltaNamespace&>(ns));
}

}  // namespace

const std::string& TTestAccess::SpecFileName(const TDeltaNamespace& ns)
{
    return RevealConst(TSpecFileNameTag(), ns);
}

const TTestAccess::TClassCache& TTestAccess::ClassCache(const TDeltaNamespace& ns)
{
    return RevealConst(TClassCacheTag(), ns);
}

void TTestAccess::ForgetWrappers(TDeltaNamespace& ns)
{
    TClassCache& cache = Reveal(TClassCacheTag(), ns);
    cache.assign(cache.size(), {});
}

void TTestAccess::PutWrapper(TDeltaNamespace& ns, std::size_t index, const std::string& name,
                             boost::shared_ptr<TDeltaClass> wrapper)
{
    Reveal(TClassCacheTag(), ns).at(index)[name] = wrapper;
}

const std::vector<boost::shared_ptr<ICIMNamespace>>& TTestAccess::CompareList(const TDeltaNamespace& ns)
{
    return RevealConst(TCompareListTag(), ns);
}

boost::shared_ptr<ICIMNamespace> TTestAccess::Store(const TDeltaNamespace& ns)
{
    return RevealConst(TStoreTag(), ns);
}

void TTestAccess::SetStore(TDeltaNamespace& ns, boost::shared_ptr<ICIMNamespace> store)
{
    Reveal(TStoreTag(), ns) = store;
}

}  // namespace NORVZEL20
