#include "embedded/mof/TMofPopulator.h"

#include <boost/ref.hpp>
#include <utility>

#include "embedded/load/TFileSource.h"

namespace NORVZEL20 {

TMofPopulator::TMofPopulator(boost::shared_ptr<ICIMNamespace> ns, boost::shared_ptr<IMofIncludes> includes)
    : fNamespace(std::move(ns)), fIncludes(std::move(includes))
{}

template <class TRead>
TLoadReport TMofPopulator::Load(const std::string& name, TRead read)
{
    TLoadSession session(fNamespace, name);
    if (fKeep) {
        session.KeepElements();
    }
    TMofDocuments documents(session, fIncludes);
    read(documents);
    TLoadReport report = session.Commit();
    fElements = session.TakeElements();
    return report;
}

TLoadReport TMofPopulator::LoadFromMemory(const char* data, std::size_t length, const std::string& name)
{
    return Load(name, [&](TMofDocuments& documents) { documents.ReadMemory(data, length, name); });
}

TLoadReport TMofPopulator::LoadFromSource(const TPullSource& source, const std::string& name)
{
    return Load(name, [&](TMofDocuments& documents) { documents.ReadSource(source, name); });
}

/// The file is opened before anything else is looked at. It is passed by reference, because the source owns it.
TLoadReport TMofPopulator::LoadFile(const std::string& path)
{
    TFileSource file(path);
    return LoadFromSource(boost::ref(file), path);
}

std::vector<boost::shared_ptr<ICIMElement>> TMofPopulator::TakeElements()
{
    return std::exchange(fElements, {});
}

}  // namespace NORVZEL20
