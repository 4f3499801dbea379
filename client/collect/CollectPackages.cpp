// Installed packages of dpkg and of rpm.
//
// Both are read from their databases, without asking a program. A system may have both, so the manager is a key; a package that is
// installed for several architectures is an instance for each one.
#include <algorithm>
#include <map>
#include <utility>

#include "client/collect/CollectKinds.h"
#include "client/collect/ReadRpmDatabase.h"
#include "client/collect/read/ReadDpkgStatus.h"
#include "client/collect/read/ReadRpmHeader.h"

namespace NORVZEL20 {

namespace {

constexpr char kDpkgStatus[] = "/var/lib/dpkg/status";

// Of dpkg, and those of rpm in all forms.
constexpr const char* kDatabases[] = {
    kDpkgStatus,
    "/usr/lib/sysimage/rpm/rpmdb.sqlite",
    "/usr/lib/sysimage/rpm/Packages",
    "/usr/lib/sysimage/rpm/Packages.db",
    "/var/lib/rpm/rpmdb.sqlite",
    "/var/lib/rpm/Packages",
    "/var/lib/rpm/Packages.db",
};

// dpkg writes changes here first, in files whose names are numbers, and takes them into its list later.
void NotePendingUpdates(TCollection& collection)
{
    const std::string folder = "/var/lib/dpkg/updates";
    const std::vector<TFolderEntry> entries = collection.GetRoot().List(folder);
    const auto count = std::count_if(entries.begin(), entries.end(), [](const TFolderEntry& entry) {
        return entry.name.find_first_not_of("0123456789") == std::string::npos;
    });
    if (count > 0) {
        collection.LeaveOut(folder, "dpkg is at work or was interrupted, so the states of some packages may be older ones");
    }
}

void CollectDpkg(TCollection& collection)
{
    const std::string path = kDpkgStatus;
    // A link that leads nowhere is a database that is missing.
    const std::optional<std::string> text = collection.GetRoot().Look(path) ? collection.Read(path) : std::nullopt;
    if (!text) {
        return;
    }
    TReadFaults faults;
    const std::vector<TFacts> packages = ReadDpkgStatus(*text, faults);
    if (packages.empty() && faults.GetCount() == 0) {
        collection.LeaveOut(path, "found no package, expected one");
    }
    collection.AddAll(packages);
    collection.LeaveOutLines(path, faults);
    NotePendingUpdates(collection);
}

// Several versions of a package may be installed, kernels above all; the latest one installed is the version of the instance.
void CollectRpm(TCollection& collection)
{
    std::map<std::pair<std::string, std::string>, std::vector<TRpmPackage>> packages;
    for (TRpmPackage& package : ReadRpmDatabase(collection)) {
        packages[{package.name, package.architecture}].push_back(std::move(package));
    }
    for (const auto& [key, versions] : packages) {
        const TRpmPackage& latest = versions.back();
        const std::string source = SourcePackageOf(latest.source);
        TFacts facts("KALMO_Package");
        facts.Key("Name", key.first)
            .Key("Architecture", key.second)
            .Key("Manager", "rpm")
            .Text("Version", latest.version)
            .Text("Source", source == key.first ? std::string() : source)
            .Text("Vendor", latest.vendor);
        if (versions.size() > 1) {
            std::vector<std::string> others;
            for (auto version = versions.rbegin() + 1; version != versions.rend(); ++version) {
                others.push_back(version->version);
            }
            facts.Texts("OtherVersions", others);
        }
        collection.Add(facts);
    }
}

}  // namespace

void CollectPackages(TCollection& collection)
{
    const TSystemRoot& root = collection.GetRoot();
    const auto isThere = [&root](const char* path) { return root.Look(path).has_value(); };
    if (std::none_of(std::begin(kDatabases), std::end(kDatabases), isThere)) {
        collection.LeaveOut("all", "no database of dpkg or rpm was found");
    }
    CollectDpkg(collection);
    CollectRpm(collection);
}

}  // namespace NORVZEL20
