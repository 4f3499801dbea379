// Which units there are, and whether they are started with the system.
//
// systemd looks for units in several folders; a file in an earlier one hides those of the same name. Links say the rest:
//
//   /etc/systemd/system/multi-user.target.wants/ssh.service    ssh.service is enabled
//   /etc/systemd/system/sshd.service -> .../ssh.service        another name; ssh.service is enabled if it has Alias=sshd.service,
//                                                              otherwise indirect
//   .../getty.target.wants/getty@tty1.service                  likewise for getty@.service and DefaultInstance=tty1
//   /etc/systemd/system/own.service -> /opt/own/own.service    own.service is linked
//   /etc/systemd/system/cups.service -> /dev/null              cups.service is masked, as by an empty file
//   /etc/systemd/system/ssh.service.d/port.conf                changes ssh.service
//
// Links in /run, those of generators too, are enabled until the next start. A unit of which no link speaks is disabled if its file
// says how it could be enabled, and static if not. An instance such as getty@tty1.service has the file of its template,
// getty@.service.
#include "client/collect/TUnitFiles.h"

#include <algorithm>
#include <array>

#include "client/collect/read/ReadUnitFile.h"
#include "client/collect/read/TextPieces.h"

namespace NORVZEL20 {

namespace {

constexpr std::array<const char*, 10> kUnitFolders = {
    "/etc/systemd/system.control", "/run/systemd/transient",      "/run/systemd/generator.early",  "/etc/systemd/system",
    "/run/systemd/system",         "/run/systemd/generator",      "/usr/local/lib/systemd/system", "/usr/lib/systemd/system",
    "/lib/systemd/system",         "/run/systemd/generator.late",
};

constexpr std::array<const char*, 6> kUnitSuffixes = {".service", ".socket", ".timer", ".path", ".target", ".automount"};

// What a unit is that has its file in this folder; empty if the folder does not decide.
std::string StateOfFolder(const std::string& folder)
{
    if (folder == "/run/systemd/transient") {
        return TUnit::kTransient;
    }
    return StartsWith(folder, "/run/systemd/generator") ? "generated" : std::string();
}

// In other folders, links come with packages.
bool IsForSettings(const std::string& folder)
{
    return folder == "/etc/systemd/system" || StartsWith(folder, "/run/");
}

std::string FolderOf(const std::string& path)
{
    return path.substr(0, path.rfind('/'));
}

std::string StateInFolder(const std::string& folder, const std::string& state)
{
    return StartsWith(folder, "/run/") ? state + "-runtime" : state;
}

std::string NameOf(const std::string& path)
{
    return path.substr(path.rfind('/') + 1);
}

// getty@.service for getty@tty1.service; empty if it is no instance.
std::string TemplateOf(const std::string& name)
{
    const std::size_t at = name.find('@');
    const std::size_t dot = name.rfind('.');
    return at == std::string::npos || dot == std::string::npos || dot <= at + 1 ? std::string()
                                                                                : name.substr(0, at + 1) + name.substr(dot);
}

}  // namespace

bool TUnitFiles::IsUnitName(const std::string& name)
{
    return std::any_of(kUnitSuffixes.begin(), kUnitSuffixes.end(),
                       [&name](const char* suffix) { return EndsWith(name, suffix) && name != suffix; });
}

TUnitFiles::TUnitFiles(TCollection& collection) : fCollection(collection)
{
    for (const std::string folder : kUnitFolders) {
        TakeFolder(folder);
    }
    AddEnabledInstances();
    for (auto& [name, unit] : fUnits) {
        FinishUnit(name, unit);
    }
}

void TUnitFiles::TakeFolder(const std::string& folder)
{
    for (const TFolderEntry& entry : EntriesOf(folder)) {
        const bool isFolder = entry.kind == TFolderEntry::EKind::kFolder;
        if (isFolder && (EndsWith(entry.name, ".wants") || EndsWith(entry.name, ".requires") || EndsWith(entry.name, ".upholds"))) {
            TakeEnabled(folder, entry.name);
        } else if (isFolder && EndsWith(entry.name, ".d")) {
            TakeDropIns(folder, entry.name);
        } else if (!isFolder && IsUnitName(entry.name)) {
            TakeUnit(folder, entry);
        }
    }
}

std::vector<TFolderEntry> TUnitFiles::EntriesOf(const std::string& folder)
{
    std::string trouble;
    std::vector<TFolderEntry> entries = fCollection.GetRoot().List(folder, trouble);
    if (!trouble.empty()) {
        fCollection.LeaveOut(folder, trouble);
    }
    return entries;
}

void TUnitFiles::TakeUnit(const std::string& folder, const TFolderEntry& entry)
{
    fCollection.CheckTime();
    if (const auto hiding = fUnits.find(entry.name); hiding != fUnits.end()) {
        TakeHidden(folder + "/" + entry.name, hiding->second);
        return;
    }
    TUnit unit;
    unit.path = folder + "/" + entry.name;
    unit.state = StateOfFolder(folder);
    if (entry.kind == TFolderEntry::EKind::kLink) {
        TakeLink(folder, entry.name, unit);
    } else {
        TakeText(unit.path, unit);
    }
    fUnits.emplace(entry.name, std::move(unit));
}

// A masked unit is described by the file that the mask hides.
void TUnitFiles::TakeHidden(const std::string& path, TUnit& unit)
{
    if (!StartsWith(unit.state, "masked") || !unit.file.description.empty()) {
        return;
    }
    TUnitFile hidden;
    ReadUnitFile(fCollection.GetRoot().Read(path).text, hidden);
    unit.file.description = hidden.description;
}

void TUnitFiles::TakeLink(const std::string& folder, const std::string& name, TUnit& unit)
{
    const std::string target = fCollection.GetRoot().ReadLink(unit.path).value_or(std::string());
    if (target == "/dev/null") {
        unit.state = StateInFolder(folder, "masked");
        return;
    }
    TakeOtherName(folder, name, target);
    if (NameOf(target) != name && TemplateOf(name) != NameOf(target)) {
        unit.state = "alias";
        return;
    }
    unit.isLinked = IsForSettings(folder) && StartsWith(target, "/") &&
                    std::find(kUnitFolders.begin(), kUnitFolders.end(), FolderOf(target)) == kUnitFolders.end();
    TakeText(unit.path, unit);
}

void TUnitFiles::TakeOtherName(const std::string& folder, const std::string& name, const std::string& target)
{
    if (IsForSettings(folder) && NameOf(target) != name) {
        fOtherNames[NameOf(target)].emplace(name, StateInFolder(folder, "enabled"));
    }
}

void TUnitFiles::TakeText(const std::string& path, TUnit& unit)
{
    const std::optional<std::string> text = fCollection.Read(path);
    if (!text) {
        unit.isRead = false;
        return;
    }
    if (text->empty()) {
        unit.state = StateInFolder(path, "masked");
    }
    ReadUnitFile(*text, unit.file);
}

void TUnitFiles::TakeEnabled(const std::string& folder, const std::string& subfolder)
{
    for (const TFolderEntry& entry : EntriesOf(folder + "/" + subfolder)) {
        fWanted.insert(entry.name);
        const std::string path = folder + "/" + subfolder + "/" + entry.name;
        fWanted.insert(NameOf(fCollection.GetRoot().ReadLink(path).value_or(std::string())));
        if (IsForSettings(folder) && IsUnitName(entry.name)) {
            fEnabled.emplace(entry.name, StateInFolder(folder, "enabled"));
            if (const std::string pattern = TemplateOf(entry.name); !pattern.empty()) {
                TakeOtherName(folder, entry.name, pattern);
            }
        }
    }
}

void TUnitFiles::TakeDropIns(const std::string& folder, const std::string& subfolder)
{
    const std::string unit = subfolder.substr(0, subfolder.size() - 2);
    for (const TFolderEntry& entry : EntriesOf(folder + "/" + subfolder)) {
        if (EndsWith(entry.name, ".conf")) {
            fDropIns[unit].emplace(entry.name, folder + "/" + subfolder + "/" + entry.name);
        }
    }
}

void TUnitFiles::AddEnabledInstances()
{
    for (const auto& [name, state] : fEnabled) {
        const auto pattern = fUnits.find(TemplateOf(name));
        if (pattern != fUnits.end() && fUnits.count(name) == 0) {
            const TUnit unit = pattern->second;
            fUnits.emplace(name, unit);
        }
    }
}

void TUnitFiles::FinishUnit(const std::string& name, TUnit& unit)
{
    for (const auto& [file, path] : fDropIns[name]) {
        unit.dropIns.push_back(path);
        if (const std::optional<std::string> text = fCollection.ReadIfThere(path)) {
            ReadUnitFile(*text, unit.file);
        }
    }
    unit.isWanted = fWanted.count(name) > 0;
    if (unit.state.empty()) {
        unit.state = StateByLinks(name, unit);
    }
    if (unit.state.empty() && unit.isRead) {
        const char* const uninstalled = unit.file.isInstalledByOthers ? "indirect" : "static";
        unit.state = unit.file.isInstalled ? "disabled" : uninstalled;
    }
}

// Empty if no link speaks of the unit.
std::string TUnitFiles::StateByLinks(const std::string& name, const TUnit& unit) const
{
    const auto enabled = fEnabled.find(name);
    if (enabled != fEnabled.end()) {
        return enabled->second;
    }
    const auto others = fOtherNames.find(name);
    if (others != fOtherNames.end()) {
        const std::string instance = name.substr(0, name.find('@') + 1) + unit.file.defaultInstance + name.substr(name.rfind('.'));
        for (const auto& [link, state] : others->second) {
            const bool isAlias = std::find(unit.file.aliases.begin(), unit.file.aliases.end(), link) != unit.file.aliases.end();
            if (isAlias || (!unit.file.defaultInstance.empty() && link == instance)) {
                return state;
            }
        }
    }
    if (!unit.isRead) {
        return std::string();
    }
    if (unit.isLinked) {
        return StateInFolder(unit.path, "linked");
    }
    return others == fOtherNames.end() ? std::string() : "indirect";
}

}  // namespace NORVZEL20
