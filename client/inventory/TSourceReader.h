#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <memory>
#include <string>
#include <utility>

#include "client/files/TByteCount.h"
#include "client/files/TPeekedSource.h"
#include "client/inventory/TIncludedFiles.h"
#include "embedded/load/TLoadSession.h"
#include "embedded/mof/TMofDocuments.h"

namespace NORVZEL20 {

/// Reads the files of an inventory into one load. This is the one place that decides in which form a file is: by its first bytes,
/// not by its name.
///
/// A file of MOF may include those in its own folder and below it. Threads: as the session.
class TSourceReader {
  public:
    /// The session must outlive this. `output` is the file of the result, which must not be included; empty for none. `count`,
    /// which may be null and otherwise must outlive this, is increased by the bytes that are read of files, included ones aside.
    TSourceReader(TLoadSession& session, std::string output, TByteCount* count)
        : fSession(session), fOutput(std::move(output)), fCount(count)
    {}

    /// Reads a file, or standard input for "-". Errors: TPopulateError, and TClientError if the file cannot be read, its
    /// compressed data is damaged or it includes the file of the result.
    void Read(const std::string& path);

  private:
    void ReadText(TPeekedSource& text, const std::string& path, const std::string& name);
    TMofDocuments& GetMof();

    TLoadSession& fSession;
    const std::string fOutput;
    TByteCount* const fCount;
    boost::shared_ptr<TIncludedFiles> fIncludes;
    std::unique_ptr<TMofDocuments> fMof;  // null before the first file of MOF
};

}  // namespace NORVZEL20
