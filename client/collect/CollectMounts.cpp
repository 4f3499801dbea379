// File systems where they are mounted.
//
// Mounts that programs make and remove by themselves, for a session or a container, are left out: they say nothing about how the
// system is set up, and each time they have other names. A file system is asked for its size only if it is on this system.
#include <sys/statvfs.h>

#include <algorithm>
#include <map>

#include "client/collect/CollectKinds.h"
#include "client/collect/IsRemote.h"
#include "client/collect/MatchesAny.h"
#include "client/collect/read/ReadMountInfo.h"

namespace NORVZEL20 {

namespace {

constexpr const char* kPassingMounts[] = {
    "/run/user/*",       "/run/credentials/*",    "/run/docker/*",      "/run/netns/*",     "/run/containerd/*", "/run/snapd/ns*",
    "/var/lib/docker/*", "/var/lib/containers/*", "/var/lib/kubelet/*", "/var/lib/lxcfs/*", "/snap/*",           "/proc/*",
    "/run/containers/*",
};

// The kernel's own file systems without files of anybody.
constexpr const char* kSizelessTypes[] = {
    "proc",    "sysfs",      "cgroup",  "cgroup2",   "devpts",    "securityfs", "pstore",
    "bpf",     "debugfs",    "tracefs", "configfs",  "mqueue",    "efivarfs",   "binfmt_misc",
    "fusectl", "rpc_pipefs", "nsfs",    "selinuxfs", "hugetlbfs", "devtmpfs",   "ramfs",
};

bool IsPassing(const TMount& mount)
{
    return MatchesAny(mount.path, kPassingMounts);
}

bool HasSize(const TMount& mount)
{
    return !IsRemote(mount.type) &&
           std::find(std::begin(kSizelessTypes), std::end(kSizelessTypes), mount.type) == std::end(kSizelessTypes);
}

void AddSizes(TFacts& facts, const TMount& mount, const TSystemRoot& root)
{
    struct statvfs sizes;
    const TDescriptor place = root.OpenPlace(mount.path);
    if (place && fstatvfs(place.Get(), &sizes) == 0 && sizes.f_blocks > 0) {
        facts.Number("FileSystemSize", static_cast<std::uint64_t>(sizes.f_blocks) * sizes.f_frsize)
            .Number("AvailableSpace", static_cast<std::uint64_t>(sizes.f_bavail) * sizes.f_frsize);
    }
}

}  // namespace

void CollectMounts(TCollection& collection)
{
    const std::string path = "/proc/self/mountinfo";
    const std::optional<std::string> text = collection.Read(path);
    if (!text) {
        return;
    }
    TReadFaults faults;
    std::map<std::string, TMount> mounts;  // by path: a later one hides an earlier one
    for (TMount& mount : ReadMountInfo(*text, faults)) {
        mounts[mount.path] = std::move(mount);
    }
    for (const auto& [place, mount] : mounts) {
        if (IsPassing(mount)) {
            continue;
        }
        TFacts facts("KALMO_Mount");
        facts.Key("Name", place)
            .Text("FileSystemType", mount.type)
            .Text("Source", mount.source)
            .Text("SourceFolder", mount.sourceFolder)
            .Texts("Options", mount.options)
            .Texts("FileSystemOptions", mount.fileSystemOptions);
        if (HasSize(mount)) {
            AddSizes(facts, mount, collection.GetRoot());
        }
        collection.Add(facts);
    }
    collection.LeaveOutLines(path, faults);
}

}  // namespace NORVZEL20
