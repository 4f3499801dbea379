#include "client/collect/CollectInventory.h"

#include <algorithm>
#include <system_error>

#include "client/collect/CollectKinds.h"
#include "client/collect/TCollection.h"
#include "client/collect/TInventoryWriter.h"

namespace NORVZEL20 {

namespace {

struct TCollectedKind {
    const char* name;
    void (*collect)(TCollection& collection);
};

constexpr TCollectedKind kCollectedKinds[] = {
    {"system", &CollectSystem},     {"processors", &CollectProcessors},
    {"memory", &CollectMemory},     {"disks", &CollectDisks},
    {"mounts", &CollectMounts},     {"network", &CollectNetwork},
    {"packages", &CollectPackages}, {"units", &CollectUnits},
    {"kernel", &CollectKernel},     {"users", &CollectUsers},
    {"jobs", &CollectJobs},         {"sockets", &CollectSockets},
    {"files", &CollectFiles},       {"certificates", &CollectCertificates},
};

constexpr char kExcludedKind[] = "files";  // to which patterns of excluded files belong

bool IsNamed(const std::vector<std::string>& names, const char* name)
{
    return std::find(names.begin(), names.end(), name) != names.end();
}

void CollectKind(TCollection& collection, const TCollectedKind& kind)
{
    const TCollectionOptions& options = collection.GetOptions();
    if (IsNamed(options.skipped, kind.name) || (!options.only.empty() && !IsNamed(options.only, kind.name))) {
        collection.LeaveOut("all", "it was not asked for");
        return;
    }
    try {
        collection.CheckTime();
        kind.collect(collection);
    } catch (const TCollection::TTimeIsUp&) {
        collection.LeaveOut("the rest", "the limit of " + std::to_string(options.timeLimit.count()) + " seconds was reached");
    } catch (const std::system_error& error) {
        collection.LeaveOut("the rest", error.code().message());
    }
}

}  // namespace

std::vector<std::string> CollectedKinds()
{
    std::vector<std::string> names;
    for (const TCollectedKind& kind : kCollectedKinds) {
        names.emplace_back(kind.name);
    }
    return names;
}

std::vector<std::string> CollectInventory(const TSystemRoot& root, ISystemCalls& calls, const TCollectionOptions& options,
                                          const TCimXmlWriter::TSink& sink)
{
    TInventoryWriter writer(sink);
    TCollection collection(root, calls, options, writer);
    for (const std::string& pattern : options.excluded) {
        collection.BeginKind(kExcludedKind);
        collection.LeaveOut(pattern, "excluded by an option");
    }
    for (const TCollectedKind& kind : kCollectedKinds) {
        collection.BeginKind(kind.name);
        CollectKind(collection, kind);
    }
    for (const TFacts& facts : collection.GetOmissions().MakeFacts()) {
        writer.Add(facts);
    }
    writer.End();
    return collection.GetOmissions().MakeLines();
}

}  // namespace NORVZEL20
