#pragma once

#include <sys/stat.h>

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "client/collect/ISystemCalls.h"
#include "client/collect/TCollectionOptions.h"
#include "client/collect/TInventoryWriter.h"
#include "client/collect/TOmissions.h"
#include "client/collect/TSystemRoot.h"
#include "client/collect/read/TFacts.h"
#include "client/collect/read/TReadFaults.h"

namespace NORVZEL20 {

class TUnitFiles;

/// One collection on its way: where facts come from, and where they go. The functions of CollectKinds.h share it.
class TCollection {
  public:
    using TReader = std::vector<TFacts> (*)(std::string_view text, TReadFaults& faults);

    /// What Add throws when the time is up. It ends the collection of all kinds.
    struct TTimeIsUp {};

    /// All must outlive this.
    TCollection(const TSystemRoot& root, ISystemCalls& calls, const TCollectionOptions& options, TInventoryWriter& writer);

    const TSystemRoot& GetRoot() const noexcept { return fRoot; }
    ISystemCalls& GetCalls() const noexcept { return fCalls; }
    const TCollectionOptions& GetOptions() const noexcept { return fOptions; }
    const TOmissions& GetOmissions() const noexcept { return fOmissions; }

    /// Whether the options exclude files of that path.
    bool IsExcluded(const std::string& path) const;

    /// Whether a file or folder is left to root: not everybody may read it, and the options do not ask for such ones. It does not
    /// depend on who collects, so the inventories of root and of another user meet.
    bool IsLeftToRoot(const struct stat& status) const;
    void LeaveToRoot(const std::string& path);

    /// What is left out from now on belongs to this kind.
    void BeginKind(const std::string& kind) { fKind = kind; }

    /// Writes an instance. One with the keys of an earlier one is left out. Errors: TTimeIsUp; those of the writer.
    void Add(const TFacts& facts);
    void AddAll(const std::vector<TFacts>& all);

    /// Notes that something of the current kind is not collected, and what a person can do about it.
    void LeaveOut(const std::string& subject, const std::string& reason, const std::string& advice = std::string());
    /// Notes lines of a file that could not be taken.
    void LeaveOutLines(const std::string& path, const TReadFaults& faults);

    /// The text of a file. One that cannot be read is left out.
    std::optional<std::string> Read(const std::string& path);
    /// The same, except that the file need not be there.
    std::optional<std::string> ReadIfThere(const std::string& path);
    /// The first line of a file that need not be there, without blanks around it; empty if it cannot be read.
    std::string ReadValue(const std::string& path) const;

    /// Reads a file and writes what the reader makes of it.
    void AddFrom(const std::string& path, TReader reader);

    /// The units' files, read when they are asked for first. What of them cannot be read is left out once, and belongs to the kind
    /// that asks first. Errors: TTimeIsUp.
    const TUnitFiles& GetUnitFiles();

    /// Errors: TTimeIsUp.
    void CheckTime() const;

  private:
    std::optional<std::string> TextOf(TFileText file, const std::string& path);

    const TSystemRoot& fRoot;
    ISystemCalls& fCalls;
    const TCollectionOptions& fOptions;
    TInventoryWriter& fWriter;
    TOmissions fOmissions;
    std::string fKind;
    std::shared_ptr<const TUnitFiles> fUnitFiles;
    std::chrono::steady_clock::time_point fEnd;
};

}  // namespace NORVZEL20
