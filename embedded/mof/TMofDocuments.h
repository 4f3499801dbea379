#pragma once

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <string>

#include "embedded/load/TLoadSession.h"
#include "embedded/load/TPopulateError.h"
#include "embedded/mof/IMofIncludes.h"
#include "host/Export.h"

namespace NORVZEL20 {

class TMofReader;

/// Reads MOF documents (DSP0004 2.x), each into the same load. TMofPopulator says what is read and how. A file is read once,
/// whether documents include it or it is a document itself, as far as IMofIncludes finds it.
///
/// Errors of every reading: TPopulateError as TMofPopulator's, except for what only TLoadSession::Commit can know;
/// std::bad_alloc. Threads: as the session.
class CIMDELTA_EXPORT TMofDocuments {
  public:
    /// Fills the buffer with at most that many bytes and returns how many; 0 ends the document. If it throws, the load fails with
    /// that exception.
    using TPullSource = boost::function<std::size_t(char*, std::size_t)>;

    /// The session must outlive this; after that this is no longer needed. `includes` finds the files that documents include; null
    /// refuses each.
    explicit TMofDocuments(TLoadSession& session, const boost::shared_ptr<IMofIncludes>& includes = {});

    /// Reads the `length` bytes at `data`. Messages call the document `name`; what it includes is looked for beside `name`.
    void ReadMemory(const char* data, std::size_t length, const std::string& name);
    /// Reads what `source` delivers, in the same way.
    void ReadSource(const TPullSource& source, const std::string& name);
    /// Reads the file at `path`. Errors: also kFileError (11) if it cannot be opened or read.
    void ReadFile(const std::string& path);

  private:
    boost::shared_ptr<TMofReader> fReader;  // the session's too
};

}  // namespace NORVZEL20
