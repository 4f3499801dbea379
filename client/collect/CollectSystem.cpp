#include "client/collect/CollectKinds.h"
#include "client/collect/read/ReadOsRelease.h"
#include "client/text/NumberIn.h"

namespace NORVZEL20 {

namespace {

constexpr std::uint64_t kLinux = 36;  // of OSType

std::string TimeZone(const TCollection& collection)
{
    const std::string link = collection.GetRoot().ReadLink("/etc/localtime").value_or(std::string());
    const std::string folder = "zoneinfo/";
    const std::size_t at = link.find(folder);
    return at == std::string::npos ? collection.ReadValue("/etc/timezone") : link.substr(at + folder.size());
}

TFacts ComputerSystem(const TCollection& collection)
{
    const std::string firmware = "/sys/class/dmi/id/";
    TFacts facts("KALMO_ComputerSystem");
    facts.Key("InstanceID", "system")
        .Text("Name", collection.ReadValue("/proc/sys/kernel/hostname"))
        .Text("Manufacturer", collection.ReadValue(firmware + "sys_vendor"))
        .Text("Model", collection.ReadValue(firmware + "product_name"))
        .Text("FirmwareVersion", collection.ReadValue(firmware + "bios_version"))
        .Text("FirmwareDate", collection.ReadValue(firmware + "bios_date"))
        .Text("TimeZone", TimeZone(collection));
    return facts;
}

// The line "btime SECONDS" of proc/stat.
std::optional<std::uint64_t> BootTime(const TCollection& collection)
{
    const std::string text = "\n" + collection.GetRoot().Read("/proc/stat").text;
    const std::string name = "\nbtime ";
    const std::size_t at = text.find(name);
    if (at == std::string::npos) {
        return std::nullopt;
    }
    const std::size_t begin = at + name.size();
    return NumberIn(std::string_view(text).substr(begin, text.find('\n', begin) - begin));
}

// What the distribution says of itself; empty if there is no such file.
std::string ReleaseText(TCollection& collection)
{
    const std::string usual = "/etc/os-release";
    bool isThere = false;
    for (const std::string& path : {usual, std::string("/usr/lib/os-release")}) {
        const TFileText file = collection.GetRoot().Read(path);
        if (file.trouble.empty()) {
            return file.text;
        }
        if (!file.isMissing) {
            isThere = true;
            collection.LeaveOut(path, file.trouble);
        }
    }
    if (!isThere) {
        collection.LeaveOut(usual, "No such file or directory");
    }
    return std::string();
}

TFacts OperatingSystem(TCollection& collection)
{
    const std::map<std::string, std::string> release = ReadOsRelease(ReleaseText(collection));
    const auto value = [&release](const char* name) {
        const auto found = release.find(name);
        return found == release.end() ? std::string() : found->second;
    };
    TFacts facts("KALMO_OperatingSystem");
    facts.Key("Name", "Linux")
        .Number("OSType", kLinux)
        .Text("Caption", value("PRETTY_NAME"))
        .Text("Distribution", value("ID"))
        .Text("Version", value("VERSION_ID"))
        .Text("KernelRelease", collection.GetCalls().Release())
        .Text("KernelVersion", collection.ReadValue("/proc/sys/kernel/version"))
        .Text("KernelArguments", collection.ReadValue("/proc/cmdline"))
        .Text("Architecture", collection.GetCalls().Machine())
        .Time("DateTimeOfCollection", collection.GetCalls().Now());
    if (const std::optional<std::uint64_t> seconds = BootTime(collection)) {
        facts.Time("LastBootUpTime", static_cast<std::int64_t>(*seconds));
    } else {
        collection.LeaveOut("the time of the last start", "/proc/stat does not say it");
    }
    return facts;
}

}  // namespace

void CollectSystem(TCollection& collection)
{
    collection.Add(ComputerSystem(collection));
    collection.Add(OperatingSystem(collection));
}

}  // namespace NORVZEL20
