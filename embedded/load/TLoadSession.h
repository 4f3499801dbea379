#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <memory>
#include <vector>

#include "embedded/load/TLoadOptions.h"
#include "embedded/load/TLoadReport.h"
#include "host/Export.h"
#include "host/ICIMElement.h"
#include "host/ICIMNamespace.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

class ILateDocuments;
class TInMemNamespace;
class TLoadContext;
class TLoader;

/// One load of one or more documents into a namespace: all of them, or nothing.
///
/// Order: begin a session, let the readers of documents (TCimXmlDocuments, TMofDocuments) read into it, and call Commit. The
/// documents may come in any order: what one of them declares, the others may use, and the rules for references within a document
/// hold for all documents together. All or nothing: if the session ends without Commit, or Commit throws, the namespace is as it
/// was. After any exception, the session can only be destroyed. Threads: use a session, and its namespace, from one thread at a
/// time.
class CIMDELTA_EXPORT TLoadSession {
  public:
    /// Returns the value, with those of its texts read that are embedded objects.
    using TReadObjects = boost::function<TCIMValue(const TCIMValue&)>;

    /// Loads into `ns`, which must be a namespace of the provider "inmem" and is kept alive. `name` is for messages only. Errors:
    /// TPopulateError with kNotSupported (31) for another namespace.
    TLoadSession(const boost::shared_ptr<ICIMNamespace>& ns, const std::string& name, const TLoadOptions& options = {});
    TLoadSession(const TLoadSession&) = delete;
    TLoadSession& operator=(const TLoadSession&) = delete;
    ~TLoadSession();

    /// From now on remembers what is added, for TakeElements.
    void KeepElements();

    /// Adds what waits for other documents, and keeps everything. Call it once, at the end. Errors: TPopulateError, as
    /// TCimXmlPopulator.
    TLoadReport Commit();

    /// The classes, then the instances, each in the order in which they were added: that of the documents, except for what waits
    /// for other documents (see ILateDocuments), which comes behind all others. Empty without KeepElements, before Commit and
    /// when called again.
    std::vector<boost::shared_ptr<ICIMElement>> TakeElements();

    /// For the readers of documents: what they add to, and how values are read whose class a later document declares.
    TLoadContext& GetContext() noexcept;
    TLoader& GetLoader() noexcept;
    const boost::shared_ptr<TInMemNamespace>& GetNamespace() const noexcept;
    void SetObjectReader(const TReadObjects& readObjects);
    /// Keeps `documents`, which Commit asks for what has waited. The first one added is asked first.
    void AddLate(const boost::shared_ptr<ILateDocuments>& documents);

  private:
    class TParts;

    std::unique_ptr<TParts> fParts;
};

}  // namespace NORVZEL20
