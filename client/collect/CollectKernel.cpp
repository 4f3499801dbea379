// Modules of the kernel, and the parameters of /proc/sys.
//
// Some files of /proc/sys are no settings: they count, they are made anew at each read, the kernel changes them or calculates
// them from the memory that is free at the start, or they are secrets. They are never read. The parameters of an interface that the
// kernel makes, such as that of a container, are left out, because there are hundreds of each; those of adapters, bonds and VLANs,
// of "all", of "default" and of lo stay. Files that can only be written are commands and are passed over without a word.
#include <fnmatch.h>

#include <algorithm>

#include "client/collect/CollectKinds.h"
#include "client/collect/MatchesAny.h"
#include "client/collect/read/ReadModules.h"
#include "client/collect/read/TextPieces.h"

namespace NORVZEL20 {

namespace {

constexpr char kParameterFolder[] = "/proc/sys";
constexpr char kInterfaceFolder[] = "/sys/class/net";
constexpr std::size_t kMostParameterBytes = 1U << 20U;
constexpr int kMostParameterFolders = 16;  // within each other

constexpr const char* kNoSettings[] = {
    "fs/aio-nr",
    "fs/binfmt_misc*",
    "fs/dentry-state",
    "fs/file-nr",
    "fs/inode-nr",
    "fs/inode-state",
    "fs/quota/*",
    "kernel/hostname",
    "kernel/hung_task_detect_count",
    "kernel/ns_last_pid",
    "kernel/perf_event_max_sample_rate",
    "kernel/pty/nr",
    "kernel/random/boot_id",
    "kernel/random/entropy_avail",
    "kernel/random/uuid",
    "kernel/random/urandom_min_reseed_secs",
    "kernel/sched_domain/*",
    "net/core/netdev_rss_key",
    "net/netfilter/nf_conntrack_count",
    "vm/stat_refresh",
    "vm/user_reserve_kbytes",
    "net/ipv*/conf/*/stable_secret",
    "net/ipv4/tcp_fastopen_key",
    "net/*/*/base_reachable_time",
    "net/*/*/retrans_time",
    "kernel/keys/*_secret",
    "dev/cdrom/info",
    "sunrpc/*/status",
    "user/*_count",
};

bool IsSetting(const std::string& name)
{
    return !MatchesAny(name, kNoSettings);
}

// Whether it is a folder such as net/ipv4/conf/veth12, of an interface that is no adapter, bond or VLAN.
bool IsOfMadeInterface(const TSystemRoot& root, const std::string& name)
{
    if (fnmatch("net/ipv[46]/conf/*", name.c_str(), FNM_PATHNAME) != 0 &&
        fnmatch("net/ipv[46]/neigh/*", name.c_str(), FNM_PATHNAME) != 0) {
        return false;
    }
    const std::string interface = name.substr(name.rfind('/') + 1);
    const bool isOfAll = interface == "all" || interface == "default" || interface == "lo";
    const std::string folder = kInterfaceFolder + ("/" + interface);
    const bool isSetUp = root.Look(folder + "/device") || root.Look(folder + "/bonding") ||
                         root.Read(folder + "/uevent").text.find("DEVTYPE=vlan\n") != std::string::npos;
    return !isOfAll && !isSetUp;
}

bool CanBeRead(const TSystemRoot& root, const std::string& path)
{
    const std::optional<struct stat> status = root.Look(path);
    return status && (status->st_mode & (S_IRUSR | S_IRGRP | S_IROTH)) != 0;
}

// Several blanks and tabs are one blank, and lines are joined by one.
std::string OneLine(const std::string& text)
{
    std::string line;
    for (const std::string_view word : SplitAtBlanks(text)) {
        line += (line.empty() ? "" : " ") + std::string(word);
    }
    return line;
}

// net/ipv4/ip_forward is called net.ipv4.ip_forward, and a dot in a name is a slash: net/ipv4/conf/eth0.5/forwarding.
std::string ParameterName(std::string path)
{
    std::transform(path.begin(), path.end(), path.begin(), [](char c) { return c == '/' ? '.' : (c == '.' ? '/' : c); });
    return path;
}

void AddParameter(TCollection& collection, const std::string& name)
{
    const std::string path = kParameterFolder + ("/" + name);
    if (!CanBeRead(collection.GetRoot(), path)) {
        return;
    }
    const TFileText file = collection.GetRoot().Read(path, kMostParameterBytes);
    if (file.trouble.empty()) {
        collection.Add(TFacts("KALMO_KernelParameter").Key("Name", ParameterName(name)).Key("Value", OneLine(file.text)));
    } else if (!file.isMissing) {
        collection.LeaveOut(ParameterName(name), file.trouble);
    }
}

// `folder` is a path below /proc/sys with a slash behind it, or empty.
void AddParameters(TCollection& collection, const std::string& folder, int depth)
{
    std::string trouble;
    for (const TFolderEntry& entry : collection.GetRoot().List(kParameterFolder + ("/" + folder), trouble)) {
        const std::string name = folder + entry.name;
        if (!IsSetting(name) || (entry.kind == TFolderEntry::EKind::kFolder && IsOfMadeInterface(collection.GetRoot(), name))) {
            continue;
        }
        if (entry.kind == TFolderEntry::EKind::kFolder && depth < kMostParameterFolders) {
            AddParameters(collection, name + "/", depth + 1);
        } else if (entry.kind == TFolderEntry::EKind::kFile) {
            AddParameter(collection, name);
        }
    }
    if (!trouble.empty()) {
        collection.LeaveOut(ParameterName(folder), trouble);
    }
}

std::vector<std::string> ModuleParameters(const TCollection& collection, const std::string& module)
{
    std::vector<std::string> parameters;
    const std::string folder = "/sys/module/" + module + "/parameters";
    for (const TFolderEntry& entry : collection.GetRoot().List(folder)) {
        const TFileText file = collection.GetRoot().Read(folder + "/" + entry.name, kMostParameterBytes);
        if (file.trouble.empty()) {
            parameters.push_back(entry.name + "=" + OneLine(file.text));
        }
    }
    return parameters;
}

void AddModules(TCollection& collection)
{
    // A kernel without modules has no list of them.
    const std::string path = "/proc/modules";
    const std::optional<std::string> text = collection.ReadIfThere(path);
    TReadFaults faults;
    for (TFacts& module : ReadModules(text.value_or(std::string()), faults)) {
        const std::string name(module.Find("Name").GetString());
        collection.Add(module.Texts("Parameters", ModuleParameters(collection, name)));
    }
    collection.LeaveOutLines(path, faults);
}

}  // namespace

void CollectKernel(TCollection& collection)
{
    AddModules(collection);
    if (!collection.GetRoot().Look(kParameterFolder)) {
        collection.LeaveOut(kParameterFolder, "there is no such folder");
    }
    if (!collection.GetRoot().Look(kInterfaceFolder)) {
        collection.LeaveOut("parameters of interfaces", std::string("there is no ") + kInterfaceFolder + " to tell adapters by");
    }
    AddParameters(collection, std::string(), 0);
}

}  // namespace NORVZEL20
