#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <set>
#include <string>
#include <vector>

#include "embedded/load/ILateDocuments.h"
#include "embedded/load/TLoadSession.h"
#include "embedded/mof/IMofIncludes.h"
#include "embedded/mof/IMofSink.h"

namespace NORVZEL20 {

/// Adds what MOF documents declare to a load: qualifiers and classes as they are read, the rest when all documents have been read.
///
/// Errors: fails through the session's context.
class TMofReader : public IMofSink, public ILateDocuments {
  public:
    /// `session` must outlive the reader. Null as `includes` refuses every include.
    TMofReader(TLoadSession& session, boost::shared_ptr<IMofIncludes> includes);

    /// Reads a document with all that it includes. Aliases are known within it.
    void Read(std::string bytes, const std::string& name);

    boost::shared_ptr<TInMemQualifierDecl> FindQualifierDecl(const std::string& name) override;
    void OnQualifierDecl(const TQualifierDraft& draft) override;
    void OnClass(TDraft draft) override;
    bool OnUndeclared(TMofPart part) override;
    void OnInstance(TMofInstance instance) override;
    void OnPragma(const std::string& name, const std::string& text) override;

    void AddClasses() override;
    void AddInstances(const TLoader::TReadObjects& readObjects) override;

  private:
    using TInstances = std::vector<TMofInstance>;

    void ReadDocument(std::string bytes, const std::string& name);
    void Include(const std::string& name);
    void SetNamespace(std::string text);
    void NoteNamespace();

    TLoadSession& fSession;
    TLoadContext& fContext;
    boost::shared_ptr<IMofIncludes> fIncludes;
    std::vector<TInstances> fUnits;       // of each document, with what it includes
    std::vector<TMofPart> fParts;         // classes that wait for qualifiers
    bool fIsLast = false;                 // whether nothing more will be declared
    std::set<std::string> fIncluded;      // identities of the included files of this unit
    std::vector<std::string> fOpenFiles;  // identities of those that are being read
    std::vector<std::string> fOpenNames;  // of the documents that are being read
    std::string fNamespaceName;           // that the document names for what follows; empty for none
    std::string fHost;                    // beside it
    TLoadPlace fNamespacePlace;
};

}  // namespace NORVZEL20
