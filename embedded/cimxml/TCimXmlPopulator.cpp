#include "embedded/cimxml/TCimXmlPopulator.h"

#include <boost/ref.hpp>
#include <utility>

#include "embedded/load/TFileSource.h"

namespace NORVZEL20 {

TCimXmlPopulator::TCimXmlPopulator(boost::shared_ptr<ICIMNamespace> ns) : fNamespace(std::move(ns)) {}

template <class TRead>
TLoadReport TCimXmlPopulator::Load(const std::string& name, TRead read)
{
    TLoadSession session(fNamespace, name);
    if (fKeep) {
        session.KeepElements();
    }
    TCimXmlDocuments documents(session);
    if (fUsesExpatAlone) {
        documents.UseExpatAlone();
    }
    read(documents);
    TLoadReport report = session.Commit();
    fElements = session.TakeElements();
    return report;
}

TLoadReport TCimXmlPopulator::LoadFromMemory(const char* data, std::size_t length, const std::string& name)
{
    return Load(name, [&](TCimXmlDocuments& documents) { documents.ReadMemory(data, length, name); });
}

TLoadReport TCimXmlPopulator::LoadFromSource(const TPullSource& source, const std::string& name)
{
    return Load(name, [&](TCimXmlDocuments& documents) { documents.ReadSource(source, name); });
}

/// The file is opened before anything else is looked at. It is passed by reference, because the source owns it.
TLoadReport TCimXmlPopulator::LoadFile(const std::string& path)
{
    TFileSource file(path);
    return LoadFromSource(boost::ref(file), path);
}

std::vector<boost::shared_ptr<ICIMElement>> TCimXmlPopulator::TakeElements()
{
    return std::exchange(fElements, {});
}

}  // namespace NORVZEL20
