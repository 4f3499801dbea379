#include "embedded/load/TLoadSession.h"

#include <string>
#include <utility>

#include "embedded/load/ILateDocuments.h"
#include "embedded/load/TLoadContext.h"
#include "embedded/load/TLoader.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// What the documents of one load share. The loader takes back what it added, unless it was committed.
class TLoadSession::TParts {
  public:
    TParts(const boost::shared_ptr<TInMemNamespace>& ns, const TLoadOptions& options)
        : fNamespace(ns), fContext(options), fLoader(fContext, ns)
    {}

    /// Instances that have waited need their classes, whichever document declares them.
    void AddLate()
    {
        for (const boost::shared_ptr<ILateDocuments>& documents : fLate) {
            documents->AddClasses();
        }
        if (!fLate.empty()) {
            fLoader.DeclareClasses();
        }
        for (const boost::shared_ptr<ILateDocuments>& documents : fLate) {
            documents->AddInstances(fReadObjects);
        }
    }

    boost::shared_ptr<TInMemNamespace> fNamespace;
    TLoadContext fContext;
    TLoader fLoader;
    std::vector<boost::shared_ptr<ILateDocuments>> fLate;
    TReadObjects fReadObjects = [](const TCIMValue& value) { return value; };
    std::vector<boost::shared_ptr<ICIMElement>> fElements;
};

namespace {

boost::shared_ptr<TInMemNamespace> RequireInMem(const boost::shared_ptr<ICIMNamespace>& ns, const std::string& name)
{
    auto known = boost::dynamic_pointer_cast<TInMemNamespace>(ns);
    if (!known) {
        throw TPopulateError(TZELStatusCode::kNotSupported,
                             "the namespace is not one of the provider \"inmem\"; load into one of those", name, 0, 0);
    }
    return known;
}

}  // namespace

TLoadSession::TLoadSession(const boost::shared_ptr<ICIMNamespace>& ns, const std::string& name, const TLoadOptions& options)
    : fParts(std::make_unique<TParts>(RequireInMem(ns, name), options))
{}

TLoadSession::~TLoadSession() = default;

void TLoadSession::KeepElements()
{
    fParts->fLoader.KeepElements();
}

TLoadReport TLoadSession::Commit()
{
    TLoader& loader = fParts->fLoader;
    fParts->fContext.Guard([&] {
        fParts->AddLate();
        fParts->fContext.CheckContents();
        loader.Finish(fParts->fReadObjects);
    });
    fParts->fContext.RefuseBadValues();
    fParts->fElements = loader.TakeElements();
    loader.Commit();
    return std::move(fParts->fContext.GetReport());
}

std::vector<boost::shared_ptr<ICIMElement>> TLoadSession::TakeElements()
{
    return std::exchange(fParts->fElements, {});
}

TLoadContext& TLoadSession::GetContext() noexcept
{
    return fParts->fContext;
}

TLoader& TLoadSession::GetLoader() noexcept
{
    return fParts->fLoader;
}

const boost::shared_ptr<TInMemNamespace>& TLoadSession::GetNamespace() const noexcept
{
    return fParts->fNamespace;
}

void TLoadSession::AddLate(const boost::shared_ptr<ILateDocuments>& documents)
{
    fParts->fLate.push_back(documents);
}

void TLoadSession::SetObjectReader(const TReadObjects& readObjects)
{
    fParts->fReadObjects = readObjects;
}

}  // namespace NORVZEL20
