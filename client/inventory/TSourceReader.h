#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <memory>
#include <string>

#include "client/files/TPeekedSource.h"
#include "embedded/load/TLoadSession.h"
#include "embedded/mof/TMofDocuments.h"
#include "embedded/mof/TMofFolders.h"

namespace NORVZEL20 {

/// Reads the files of an inventory into one load. This is the one place that decides in which form a file is: by its first bytes,
/// not by its name.
///
/// A file of MOF may include those in its own folder and below it. Threads: as the session.
class TSourceReader {
  public:
    /// The session must outlive this.
    explicit TSourceReader(TLoadSession& session) : fSession(session) {}

    /// Reads a file, or standard input for "-". Errors: TPopulateError, and TClientError if the file cannot be read or its
    /// compressed data is damaged.
    void Read(const std::string& path);

  private:
    void ReadText(TPeekedSource& text, const std::string& path, const std::string& name);
    TMofDocuments& GetMof();

    TLoadSession& fSession;
    boost::shared_ptr<TMofFolders> fFolders;
    std::unique_ptr<TMofDocuments> fMof;  // null before the first file of MOF
};

}  // namespace NORVZEL20
