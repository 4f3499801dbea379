// Processors, memory, and disks with their partitions.
//
// The kernel shows each block device as a folder of /sys/block, with its partitions as folders in it. Sizes are counted there in
// units of 512 bytes, whatever the device's own blocks are. Devices of memory (ram), and loop devices without a file, are left out.
#include "client/collect/CollectKinds.h"
#include "client/collect/read/ReadHardware.h"
#include "client/collect/read/TextPieces.h"
#include "client/text/NumberIn.h"

namespace NORVZEL20 {

namespace {

constexpr std::uint64_t kSectorBytes = 512;

void AddNumber(TFacts& facts, const char* property, const std::string& text, std::uint64_t unit = 1)
{
    if (const std::optional<std::uint64_t> number = NumberIn(text); number && *number <= UINT64_MAX / unit) {
        facts.Number(property, *number * unit);
    }
}

void AddFlag(TFacts& facts, const char* property, const std::string& text)
{
    if (text == "0" || text == "1") {
        facts.Flag(property, text == "1");
    }
}

// "none [mq-deadline] kyber"
std::string ChosenIn(const std::string& text)
{
    const std::size_t begin = text.find('[');
    const std::size_t end = text.find(']');
    return begin == std::string::npos || end < begin ? std::string() : text.substr(begin + 1, end - begin - 1);
}

std::string FirstOf(const std::string& first, const std::string& second)
{
    return first.empty() ? second : first;
}

std::vector<std::string> NamesIn(const TSystemRoot& root, const std::string& folder)
{
    std::vector<std::string> names;
    for (const TFolderEntry& entry : root.List(folder)) {
        names.push_back(entry.name);
    }
    return names;
}

void AddPartition(TCollection& collection, const std::string& disk, const std::string& name)
{
    const std::string folder = "/sys/block/" + disk + "/" + name + "/";
    TFacts facts("KALMO_DiskPartition");
    facts.Key("DeviceID", name).Text("Disk", disk);
    AddNumber(facts, "Number", collection.ReadValue(folder + "partition"));
    AddNumber(facts, "Size", collection.ReadValue(folder + "size"), kSectorBytes);
    AddNumber(facts, "StartingOffset", collection.ReadValue(folder + "start"), kSectorBytes);
    AddFlag(facts, "ReadOnly", collection.ReadValue(folder + "ro"));
    collection.Add(facts);
}

void AddDisk(TCollection& collection, const std::string& disk)
{
    const std::string folder = "/sys/block/" + disk + "/";
    const std::string size = collection.ReadValue(folder + "size");
    if (StartsWith(disk, "ram") || (StartsWith(disk, "loop") && size == "0")) {
        return;
    }
    TFacts facts("KALMO_Disk");
    facts.Key("DeviceID", disk)
        .Text("Manufacturer", collection.ReadValue(folder + "device/vendor"))
        .Text("Model", collection.ReadValue(folder + "device/model"))
        .Text("SerialNumber", FirstOf(collection.ReadValue(folder + "device/serial"), collection.ReadValue(folder + "serial")))
        .Text("ElementName", FirstOf(collection.ReadValue(folder + "dm/name"), collection.ReadValue(folder + "md/level")))
        .Text("Scheduler", ChosenIn(collection.ReadValue(folder + "queue/scheduler")))
        .Text("BackingFile", collection.ReadValue(folder + "loop/backing_file"))
        .Texts("Parts", NamesIn(collection.GetRoot(), folder + "slaves"));
    AddNumber(facts, "Size", size, kSectorBytes);
    AddNumber(facts, "BlockSize", collection.ReadValue(folder + "queue/logical_block_size"));
    AddFlag(facts, "ReadOnly", collection.ReadValue(folder + "ro"));
    AddFlag(facts, "Rotational", collection.ReadValue(folder + "queue/rotational"));
    AddFlag(facts, "Removable", collection.ReadValue(folder + "removable"));
    collection.Add(facts);
    for (const std::string& name : NamesIn(collection.GetRoot(), folder)) {
        if (StartsWith(name, disk) && !collection.ReadValue(folder + name + "/partition").empty()) {
            AddPartition(collection, disk, name);
        }
    }
}

}  // namespace

void CollectProcessors(TCollection& collection)
{
    const std::string path = "/proc/cpuinfo";
    if (const std::optional<std::string> text = collection.Read(path)) {
        const std::vector<TFacts> processors = ReadProcessors(*text);
        if (processors.empty()) {
            collection.LeaveOut(path, "found no processor, expected one");
        }
        collection.AddAll(processors);
    }
}

void CollectMemory(TCollection& collection)
{
    const std::string path = "/proc/meminfo";
    if (const std::optional<std::string> text = collection.Read(path)) {
        if (const std::optional<TFacts> memory = ReadMemory(*text)) {
            collection.Add(*memory);
        } else {
            collection.LeaveOut(path, "found no line MemTotal, expected one");
        }
    }
    collection.AddFrom("/proc/swaps", &ReadSwapAreas);
}

void CollectDisks(TCollection& collection)
{
    const std::string folder = "/sys/block";
    std::string trouble;
    const std::vector<TFolderEntry> disks = collection.GetRoot().List(folder, trouble);
    if (!trouble.empty() || !collection.GetRoot().Look(folder)) {
        collection.LeaveOut(folder, trouble.empty() ? "there is no such folder" : trouble);
    }
    for (const TFolderEntry& disk : disks) {
        AddDisk(collection, disk.name);
    }
}

}  // namespace NORVZEL20
