#include "provider/TDeltaNamespace.h"

#include <iostream>
#include <utility>

#include "engine/TCIMDiffEngine.h"
#include "host/TNamespacePopulator.h"
#include "host/TNamespaceProviderManager.h"
#include "host/TOSSpecific.h"
#include "host/TZELException.h"
#include "provider/DeltaNames.h"
#include "provider/Refuse.h"
#include "provider/TDeltaClass.h"
#include "provider/TDeltaNamespaceProvider.h"

// Where a request goes:
//
//     instances, queries         to the store, which holds the records
//     GetClass                   to the store; if the store has no such class, to the compared namespace at "nsIndex"
//     qualifier declarations     to the compared namespace at "nsIndex"
//     changes of the schema, enumerations of root classes and providers: refused
//
// "nsIndex" is an entry of the call context, and a position in the compare list. Wrappers of classes are cached by position and
// name, with one map for each entry of the compare list.

namespace NORVZEL20 {

namespace {

const std::string kFileSeparator = "/";

}  // namespace

TDeltaNamespace::TDeltaNamespace()
{
    const boost::shared_ptr<INamespaceProvider> inmem = TNamespaceProviderManager::GetInstance()->FindProvider("inmem");
    fDeltaStore = inmem->AllocateNamespace(TCallContext(), false, "root/cimv2");
    const std::string schema =
        TOSSpecific::GetZELRootPath() + kFileSeparator + "data" + kFileSeparator + "deltaclasses.properties.xml";
    TNamespacePopulator::PopulateFromXMLFile(fDeltaStore, schema);
}

TDeltaNamespace::TDeltaNamespace(boost::shared_ptr<const ICIMNamespace>) {}

TDeltaNamespace::~TDeltaNamespace() = default;

void TDeltaNamespace::Initialize() {}

void TDeltaNamespace::SetSpecFileName(std::string name)
{
    fSpecFileName = std::move(name);
}

void TDeltaNamespace::AddNamespaceToCompareList(boost::shared_ptr<ICIMNamespace> ns)
{
    fCompareList.push_back(std::move(ns));
    try {
        fClassCache.emplace_back();
    } catch (...) {
        fCompareList.pop_back();  // the two lists must have the same length
        throw;
    }
}

unsigned short TDeltaNamespace::NumContainers() const
{
    return static_cast<unsigned short>(fCompareList.size());
}

void TDeltaNamespace::FindDifferences()
{
    const std::string specFileName = fSpecFileName;
    // The engine needs an owning pointer. If there is none, this throws before the run has any effect.
    const boost::shared_ptr<ICIMNamespace> self = shared_from_this();
    TCIMDiffEngine engine(self, fCompareList, specFileName);
    engine.compare();
}

unsigned short TDeltaNamespace::GetDiffIndex(TCallContext context) const
{
    const auto entry = context.find(kNamespaceIndexEntry);
    if (entry == context.end()) {
        throw TZELException(TZELStatusCode::kMissingParameter);
    }
    const unsigned short index = entry->second;
    if (index >= NumContainers()) {
        const std::string line = "Bad nsIndex, nsIndex=" + std::to_string(index) + "\n";
        // Unformatted output: base, width and locale that others have set on the stream do not change the line.
        std::cout.write(line.data(), static_cast<std::streamsize>(line.size())).flush();
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return index;
}

boost::shared_ptr<INamespaceProvider> TDeltaNamespace::GetNamespaceProvider(TCallContext) const
{
    return TDeltaNamespaceProvider::GetInstance();
}

void TDeltaNamespace::SetUpcallNamespace(boost::shared_ptr<ICIMNamespace>, TCallContext)
{
    Refuse();
}

void TDeltaNamespace::AddUnderlyingNamespace(boost::shared_ptr<ICIMNamespace>, TCallContext)
{
    Refuse();
}

boost::shared_ptr<ICIMClass> TDeltaNamespace::AllocateClass(const std::string&, boost::shared_ptr<ICIMClass>, TCallContext)
{
    Refuse();
}

boost::shared_ptr<ICIMClass> TDeltaNamespace::GetClass(const std::string& name, TCallContext context)
{
    try {
        return fDeltaStore->GetClass(name, context);
    } catch (const TZELException& error) {
        if (error.GetStatusCode() != TZELStatusCode::kNotFound) {
            // Only the status is passed on, because the caller may not know the type of the host's exception.
            throw TZELException(error.GetStatusCode());
        }
    }
    return GetWrappedClass(name, context);
}

boost::shared_ptr<ICIMClass> TDeltaNamespace::GetWrappedClass(const std::string& name, const TCallContext& context)
{
    const unsigned short index = GetDiffIndex(context);
    const auto cached = fClassCache[index].find(name);
    if (cached != fClassCache[index].end()) {
        return cached->second;
    }
    const boost::shared_ptr<ICIMClass> cls = fCompareList[index]->GetClass(name, context);
    const boost::shared_ptr<TDeltaClass> wrapper(new TDeltaClass(shared_from_this(), cls));
    // This comes last: if anything above fails, the cache is as it was.
    fClassCache[index].emplace(name, wrapper);
    return wrapper;
}

void TDeltaNamespace::EnumerateRootClasses(const boost::function<bool(boost::shared_ptr<ICIMClass>)>&, TCallContext)
{
    Refuse();
}

void TDeltaNamespace::EnumerateProviders(const boost::function<bool(boost::shared_ptr<IProvider>)>&, TCallContext)
{
    Refuse();
}

boost::shared_ptr<ICIMQualifierDecl> TDeltaNamespace::AllocateQualifierDecl(const std::string&, const TCIMValue&,
                                                                            ICIMQualifierDecl::EScope, ICIMQualifierDecl::EFlavor,
                                                                            TCallContext)
{
    Refuse();
}

boost::shared_ptr<ICIMQualifierDecl> TDeltaNamespace::GetQualifierDecl(const std::string& name, TCallContext context) const
{
    return fCompareList[GetDiffIndex(context)]->GetQualifierDecl(name, context);
}

void TDeltaNamespace::EnumerateQualifierDecls(const boost::function<bool(boost::shared_ptr<ICIMQualifierDecl>)>& callback,
                                              TCallContext context) const
{
    fCompareList[GetDiffIndex(context)]->EnumerateQualifierDecls(callback, context);
}

void TDeltaNamespace::Subscribe(boost::shared_ptr<ICIMIndicationFilter>,
                                const boost::function<bool(boost::shared_ptr<ICIMInstance>)>&, TCallContext)
{
    throw TZELException(TZELStatusCode::kNotOffered);
}

boost::shared_ptr<ICIMInstance> TDeltaNamespace::GetInstance(const TCIMReference& path, TCallContext context) const
{
    return fDeltaStore->GetInstance(path, context);
}

void TDeltaNamespace::DeleteInstance(const TCIMReference& path, TCallContext context)
{
    fDeltaStore->DeleteInstance(path, context);
}

void TDeltaNamespace::ModifyInstance(const TCIMReference& path, TCallContext properties, TCallContext context)
{
    fDeltaStore->ModifyInstance(path, properties, context);
}

void TDeltaNamespace::ExecuteQuery(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, std::string& language,
                                   std::string& query, TCallContext context)
{
    fDeltaStore->ExecuteQuery(callback, language, query, context);
}

void TDeltaNamespace::ClearInstances() {}

ICIMNamespace& TDeltaNamespace::operator=(ICIMNamespace&)
{
    return *this;
}

TDeltaNamespace& TDeltaNamespace::operator=(const TDeltaNamespace&)
{
    return *this;
}

}  // namespace NORVZEL20
