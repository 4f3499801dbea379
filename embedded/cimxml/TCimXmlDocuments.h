#pragma once

#include <boost/function.hpp>
#include <cstddef>
#include <string>

#include "embedded/load/TLoadSession.h"
#include "embedded/load/TPopulateError.h"
#include "host/Export.h"

namespace NORVZEL20 {

/// Reads CIM-XML documents (DSP0201), each into the same load. TCimXmlPopulator says what is read and how.
///
/// Errors of every reading: TPopulateError as TCimXmlPopulator's, except for what only TLoadSession::Commit can know;
/// std::bad_alloc. Threads: as the session.
class CIMDELTA_EXPORT TCimXmlDocuments {
  public:
    /// Fills the buffer with at most that many bytes and returns how many. It may return as few as it likes: small pieces are
    /// gathered before they are parsed. 0 ends the document; the source is not called again after that. If it throws, the load
    /// fails with that exception.
    using TPullSource = boost::function<std::size_t(char*, std::size_t)>;

    /// The session must outlive this.
    explicit TCimXmlDocuments(TLoadSession& session);

    /// Reads the `length` bytes at `data`. Messages call the document `name`.
    void ReadMemory(const char* data, std::size_t length, const std::string& name);
    /// Reads what `source` delivers. Messages call the document `name`.
    void ReadSource(const TPullSource& source, const std::string& name);
    /// Reads the file at `path`. Errors: also kFileError (11) if it cannot be opened or read.
    void ReadFile(const std::string& path);

    /// From now on reads documents through Expat alone: the results are the same, and reading takes several times as long. For
    /// tests.
    void UseExpatAlone() { fUsesExpatAlone = true; }

  private:
    template <class TRead>
    void Read(const std::string& name, TRead read);

    TLoadSession& fSession;
    bool fUsesExpatAlone = false;
};

}  // namespace NORVZEL20
