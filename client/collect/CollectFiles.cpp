// Configuration files: their digests, owners and permissions.
//
// Whether the contents are read depends on the permissions and the name, not on who collects, so the inventories of root and of
// another user meet: a file that not everybody may read has a digest only if --root-files asked for it, and one for keys or
// passwords never has one. Who owns them, and with which permissions, is in the inventory all the same.
#include <fnmatch.h>

#include <algorithm>
#include <array>
#include <map>

#include "client/collect/CollectKinds.h"
#include "client/collect/DigestFile.h"
#include "client/collect/HoldsSecrets.h"
#include "client/collect/MatchesAny.h"
#include "client/collect/TFileWalk.h"
#include "client/collect/TUnitFiles.h"
#include "client/collect/read/ReadAccounts.h"
#include "client/collect/read/TextPieces.h"

namespace NORVZEL20 {

namespace {

constexpr std::array<const char*, 2> kConfigurationFolders = {"/etc", "/usr/local/etc"};

// What programs write by themselves, and what editors and package managers have there while they work. Copies that stay, such as
// site~ and site.bak, are read by programs that read whole folders.
constexpr const char* kNoConfiguration[] = {
    "*/.*.sw[op]",
    "*/.git",
    "/etc/*.dpkg-new",
    "/etc/*.dpkg-tmp",
    "/etc/.pwd.lock",
    "/etc/.updated",
    "/etc/adjtime",
    "/etc/aliases.db",
    "/etc/blkid*",
    "/etc/cups/subscriptions.conf*",
    "/etc/fake-hwclock.data",
    "/etc/group-",
    "/etc/ld.so.cache",
    "/etc/lvm/archive",
    "/etc/lvm/backup",
    "/etc/lvm/cache",
    "/etc/machine-id",
    "/etc/mtab",
    "/etc/passwd-",
    "/etc/printcap",
    "/etc/random-seed",
    "/etc/subgid-",
    "/etc/subuid-",
    "/etc/udev/hwdb.bin",
};

// Users and groups are instances of their own.
constexpr std::array<const char*, 4> kAccountFiles = {"/etc/passwd", "/etc/group", "/etc/subuid", "/etc/subgid"};

std::string TypeOf(mode_t mode)
{
    switch (mode & S_IFMT) {
    case S_IFREG:
        return "file";
    case S_IFDIR:
        return "folder";
    case S_IFLNK:
        return "link";
    case S_IFIFO:
        return "fifo";
    case S_IFSOCK:
        return "socket";
    default:
        return "device";
    }
}

std::string ModeText(mode_t mode)
{
    std::string text;
    for (const unsigned int shift : {9U, 6U, 3U, 0U}) {
        text += static_cast<char>('0' + (mode >> shift & 7U));
    }
    return text;
}

class TConfigurationFiles {
  public:
    explicit TConfigurationFiles(TCollection& collection)
        : fCollection(collection), fUsers(NamesByNumber("/etc/passwd", &ReadUsers, "UserID")),
          fGroups(NamesByNumber("/etc/group", &ReadGroups, "GroupID"))
    {}

    bool IsWanted(const std::string& path) const
    {
        return !fCollection.IsExcluded(path) && !MatchesAny(path, kNoConfiguration) && !IsRepeatedByUnit(path);
    }

    bool Visit(const std::string& path, const struct stat& status)
    {
        TFacts facts("KALMO_ConfigurationFile");
        facts.Key("Name", path)
            .Text("Type", TypeOf(status.st_mode))
            .Text("Owner", NameOf(fUsers, status.st_uid))
            .Text("Group", NameOf(fGroups, status.st_gid));
        if (S_ISLNK(status.st_mode)) {
            facts.Text("LinkTarget", fCollection.GetRoot().ReadLink(path).value_or(std::string()));
        } else {
            facts.Text("Mode", ModeText(status.st_mode));
        }
        if (S_ISREG(status.st_mode)) {
            AddContents(facts, path, status);
        }
        fCollection.Add(facts);
        if (S_ISDIR(status.st_mode) && fCollection.IsLeftToRoot(status)) {
            fCollection.LeaveToRoot(path);
            return false;
        }
        return true;
    }

  private:
    using TNames = std::map<std::string, std::string>;

    // Whether it is a link such as /etc/rc3.d/S01ssh, and systemd starts ssh.service instead. The state of that unit says whether
    // it is enabled, and both change together. For a script without such a unit, the links are what says it.
    bool IsRepeatedByUnit(const std::string& path) const
    {
        if (fnmatch("/etc/rc[0-9S].d/[KS][0-9][0-9]*", path.c_str(), FNM_PATHNAME) != 0 ||
            !fCollection.GetRoot().Look("/run/systemd/system")) {
            return false;
        }
        std::string script = path.substr(std::string("/etc/rc3.d/S01").size());
        script = EndsWith(script, ".sh") ? script.substr(0, script.size() - 3) : script;
        const std::map<std::string, TUnit>& units = fCollection.GetUnitFiles().GetUnits();
        const auto unit = units.find(script + ".service");
        return unit != units.end() && unit->second.state != "generated";
    }

    TNames NamesByNumber(const std::string& path, TCollection::TReader reader, const char* number) const
    {
        TNames names;
        TReadFaults ignored;  // reported with the users
        for (const TFacts& facts : reader(fCollection.GetRoot().Read(path).text, ignored)) {
            names.emplace(facts.Find(number).ToText(), facts.Find("Name").ToText());
        }
        return names;
    }

    static std::string NameOf(const TNames& names, unsigned int number)
    {
        const auto found = names.find(std::to_string(number));
        return found == names.end() ? std::to_string(number) : found->second;
    }

    void AddContents(TFacts& facts, const std::string& path, const struct stat& status)
    {
        const auto isPath = [&path](const char* other) { return path == other; };
        if (std::any_of(std::begin(kAccountFiles), std::end(kAccountFiles), isPath)) {
            return;
        }
        std::string trouble;
        if (HoldsSecrets(path)) {
            trouble = kSecretReason;
        } else if (fCollection.IsLeftToRoot(status)) {
            fCollection.LeaveToRoot(path);
        } else if (const std::string digest = DigestFile(fCollection.GetRoot(), path, trouble); !digest.empty()) {
            facts.Text("Digest", digest);
        }
        if (!trouble.empty()) {
            fCollection.LeaveOut(path, trouble);
        }
    }

    TCollection& fCollection;
    TNames fUsers;
    TNames fGroups;
};

}  // namespace

void CollectFiles(TCollection& collection)
{
    TConfigurationFiles files(collection);
    TFileWalk walk(
        collection, [&files](const std::string& path) { return files.IsWanted(path); },
        [&files](const std::string& path, const struct stat& status) { return files.Visit(path, status); });
    for (const char* const folder : kConfigurationFolders) {
        walk.Walk(folder);
    }
}

}  // namespace NORVZEL20
