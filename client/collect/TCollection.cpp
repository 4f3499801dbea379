#include "client/collect/TCollection.h"

#include <utility>

#include "client/collect/MatchesAny.h"
#include "client/collect/TUnitFiles.h"
#include "client/collect/read/TTextLines.h"
#include "client/collect/read/TextPieces.h"
#include "client/collect/read/ValidText.h"

namespace NORVZEL20 {

TCollection::TCollection(const TSystemRoot& root, ISystemCalls& calls, const TCollectionOptions& options, TInventoryWriter& writer)
    : fRoot(root), fCalls(calls), fOptions(options), fWriter(writer), fEnd(calls.Tick() + options.timeLimit)
{}

bool TCollection::IsExcluded(const std::string& path) const
{
    return MatchesAny(path, fOptions.excluded);
}

bool TCollection::IsLeftToRoot(const struct stat& status) const
{
    const mode_t needed = S_ISDIR(status.st_mode) ? S_IROTH | S_IXOTH : S_IROTH;
    return (status.st_mode & needed) != needed && !fOptions.hasRootFiles;
}

void TCollection::LeaveToRoot(const std::string& path)
{
    LeaveOut(path, "not everybody may read it", "as root, --root-files includes it");
}

void TCollection::CheckTime() const
{
    if (fCalls.Tick() > fEnd) {
        throw TTimeIsUp();
    }
}

void TCollection::Add(const TFacts& facts)
{
    CheckTime();
    if (!fWriter.Add(facts)) {
        const TFacts::TValue& key = facts.GetValues().front();
        LeaveOut(std::string(facts.GetClassName()) + " " + key.second.ToText(), "there was one with the same keys before");
    }
}

void TCollection::AddAll(const std::vector<TFacts>& all)
{
    for (const TFacts& facts : all) {
        Add(facts);
    }
}

void TCollection::LeaveOut(const std::string& subject, const std::string& reason, const std::string& advice)
{
    fOmissions.Add(fKind, ValidText(reason), ValidText(subject), advice);
}

void TCollection::LeaveOutLines(const std::string& path, const TReadFaults& faults)
{
    if (faults.GetCount() > 0) {
        const std::size_t others = faults.GetCount() - 1;
        LeaveOut(path, faults.GetFirst() + (others == 0 ? "" : " (" + std::to_string(others) + " more of its lines are left out)"));
    }
}

std::optional<std::string> TCollection::TextOf(TFileText file, const std::string& path)
{
    if (file.trouble.empty()) {
        return std::move(file.text);
    }
    LeaveOut(path, file.trouble);
    return std::nullopt;
}

std::optional<std::string> TCollection::Read(const std::string& path)
{
    return TextOf(fRoot.Read(path), path);
}

std::optional<std::string> TCollection::ReadIfThere(const std::string& path)
{
    TFileText file = fRoot.Read(path);
    return file.isMissing ? std::nullopt : TextOf(std::move(file), path);
}

std::string TCollection::ReadValue(const std::string& path) const
{
    const TFileText file = fRoot.Read(path);
    TTextLines lines(file.text);
    return lines.Next() ? std::string(Trimmed(lines.GetLine())) : std::string();
}

const TUnitFiles& TCollection::GetUnitFiles()
{
    if (!fUnitFiles) {
        fUnitFiles = std::make_shared<const TUnitFiles>(*this);
    }
    return *fUnitFiles;
}

void TCollection::AddFrom(const std::string& path, TReader reader)
{
    if (const std::optional<std::string> text = Read(path)) {
        TReadFaults faults;
        AddAll(reader(*text, faults));
        LeaveOutLines(path, faults);
    }
}

}  // namespace NORVZEL20
