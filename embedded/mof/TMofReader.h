#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <map>
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

    /// Reads a document with all that it includes. Aliases are known within it. A file is read once in a session, so a document
    /// that is a file which another one has included is not read again.
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
    /// The instances of a document, with those of what it includes.
    struct TUnit {
        std::vector<TMofInstance> instances;
        std::vector<std::string> repeated;  // identities of the files that it includes, but that an earlier unit has read
    };

    /// A file that was read: its instances are those of a unit from `begin` to `end`.
    struct TFile {
        std::size_t unit;
        std::size_t begin;
        std::size_t end;
        std::vector<std::string> includes;  // identities
    };

    std::string Identify(const std::string& name) const;
    bool NoteFile(const std::string& identity);
    void ReadDocument(std::string bytes, const std::string& name);
    void Include(const std::string& name);
    void SetNamespace(std::string text);
    void NoteNamespace();
    std::vector<const TMofInstance*> FindAliased(std::size_t unit) const;

    TLoadSession& fSession;
    TLoadContext& fContext;
    boost::shared_ptr<IMofIncludes> fIncludes;
    std::vector<TUnit> fUnits;
    std::vector<TMofPart> fParts;         // classes that wait for qualifiers
    bool fIsLast = false;                 // whether nothing more will be declared
    std::map<std::string, TFile> fFiles;  // by identity
    std::vector<std::string> fOpenFiles;  // identities of those that are being read
    std::vector<std::string> fOpenNames;  // of the documents that are being read
    std::string fNamespaceName;           // that the document names for what follows; empty for none
    std::string fHost;                    // beside it
    TLoadPlace fNamespacePlace;
};

}  // namespace NORVZEL20
