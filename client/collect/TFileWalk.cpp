#include "client/collect/TFileWalk.h"

#include <utility>

#include "client/collect/IsRemote.h"
#include "client/collect/read/ReadMountInfo.h"

namespace NORVZEL20 {

TFileWalk::TFileWalk(TCollection& collection, std::function<bool(const std::string& path)> isWanted, TVisit visit)
    : fCollection(collection), fIsWanted(std::move(isWanted)), fVisit(std::move(visit))
{
    TReadFaults ignored;
    for (const TMount& mount : ReadMountInfo(collection.GetRoot().Read("/proc/self/mountinfo").text, ignored)) {
        if (IsRemote(mount.type)) {
            fRemote.insert(mount.path);
        }
    }
}

void TFileWalk::WalkFolder(const std::string& folder, int depth)
{
    std::string trouble;
    for (const TFolderEntry& entry : fCollection.GetRoot().List(folder, trouble)) {
        const std::string path = folder + "/" + entry.name;
        if (!fIsWanted(path)) {
            continue;
        }
        if (fRemote.count(path) > 0) {
            fCollection.LeaveOut(path, "it is on another system");
            continue;
        }
        fCollection.CheckTime();
        const std::optional<struct stat> status = fCollection.GetRoot().Look(path);
        if (!status || fCount == kMostFiles) {
            fCollection.LeaveOut(path, status ? "there are more than " + std::to_string(kMostFiles) + " files" : "it vanished");
            continue;
        }
        ++fCount;
        if (!fVisit(path, *status) || !S_ISDIR(status->st_mode)) {
            continue;
        }
        if (depth < kMostFolders) {
            WalkFolder(path, depth + 1);
        } else {
            fCollection.LeaveOut(path, "it is within more than " + std::to_string(kMostFolders) + " folders");
        }
    }
    if (!trouble.empty()) {
        fCollection.LeaveOut(folder, trouble);
    }
}

}  // namespace NORVZEL20
