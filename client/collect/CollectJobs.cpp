// Jobs of cron and anacron, and timers of systemd.
//
// A job is known by where it stands, what it does and for whom; when it does it is a property. So a job that is moved to another
// hour shows as one change. The scripts in folders such as /etc/cron.daily are jobs of the line that runs the folder.
//
// Commands may hold passwords, so a table that not everybody may read is left out unless --root-files asks for it.
#include <algorithm>
#include <map>
#include <tuple>

#include "client/collect/CollectKinds.h"
#include "client/collect/TUnitFiles.h"
#include "client/collect/read/ReadCrontab.h"
#include "client/collect/read/TextPieces.h"

namespace NORVZEL20 {

namespace {

class TScheduledJobs {
  public:
    void Add(const std::string& source, const TJob& job) { fSchedules[{source, job.command, job.user}].push_back(job.schedule); }

    void WriteTo(TCollection& collection)
    {
        for (auto& [key, schedules] : fSchedules) {
            std::sort(schedules.begin(), schedules.end());
            collection.Add(TFacts("KALMO_ScheduledJob")
                               .Key("Source", std::get<0>(key))
                               .Key("Command", std::get<1>(key))
                               .Key("User", std::get<2>(key))
                               .Texts("Schedules", schedules));
        }
    }

  private:
    std::map<std::tuple<std::string, std::string, std::string>, std::vector<std::string>> fSchedules;
};

// Whether a table, or a folder of tables, may be read; one that is left to root is left out.
bool MayRead(TCollection& collection, const std::string& path)
{
    const TDescriptor place = collection.GetRoot().OpenPlace(path);
    struct stat status;
    if (place && fstat(place.Get(), &status) == 0 && collection.IsLeftToRoot(status)) {
        collection.LeaveToRoot(path);
        return false;
    }
    return true;
}

void AddJobs(TCollection& collection, TScheduledJobs& jobs, const std::string& path,
             std::vector<TJob> (*read)(std::string_view, TReadFaults&), const std::string& user = std::string())
{
    const std::optional<std::string> text = MayRead(collection, path) ? collection.ReadIfThere(path) : std::nullopt;
    if (!text) {
        return;
    }
    TReadFaults faults;
    for (TJob& job : read(*text, faults)) {
        job.user = job.user.empty() ? user : job.user;
        jobs.Add(path, job);
    }
    collection.LeaveOutLines(path, faults);
}

std::vector<TJob> ReadSystemTable(std::string_view text, TReadFaults& faults)
{
    return ReadCrontab(text, true, faults);
}

std::vector<TJob> ReadUserTable(std::string_view text, TReadFaults& faults)
{
    return ReadCrontab(text, false, faults);
}

std::vector<TFolderEntry> FilesIn(TCollection& collection, const std::string& folder, bool hasDots = false)
{
    if (!MayRead(collection, folder)) {
        return {};
    }
    std::string trouble;
    std::vector<TFolderEntry> entries = collection.GetRoot().List(folder, trouble);
    if (!trouble.empty()) {
        collection.LeaveOut(folder, trouble);
    }
    // cron passes over names with a dot, and so over what packages leave behind. Names of users may have one.
    const auto isNoTable = [hasDots](const TFolderEntry& entry) {
        const std::size_t dot = entry.name.find('.');
        return entry.kind == TFolderEntry::EKind::kFolder || EndsWith(entry.name, "~") || dot == 0 ||
               (dot != std::string::npos && !hasDots);
    };
    entries.erase(std::remove_if(entries.begin(), entries.end(), isNoTable), entries.end());
    return entries;
}

void AddScripts(TCollection& collection, TScheduledJobs& jobs, const std::string& period)
{
    const std::string folder = "/etc/cron." + period;
    for (const TFolderEntry& entry : FilesIn(collection, folder)) {
        jobs.Add(folder, {"@" + period, "root", folder + "/" + entry.name});
    }
}

void AddTimers(TCollection& collection, TScheduledJobs& jobs)
{
    for (const auto& [name, unit] : collection.GetUnitFiles().GetUnits()) {
        // A template is no timer. Only one that is started with the system asks for its unit.
        if (name.find("@.") != std::string::npos || unit.state == "disabled" || StartsWith(unit.state, "linked") ||
            StartsWith(unit.state, "masked")) {
            continue;
        }
        for (const std::string& schedule : unit.file.schedules) {
            jobs.Add(name, {schedule, std::string(), unit.Activated(name)});
        }
    }
}

}  // namespace

void CollectJobs(TCollection& collection)
{
    TScheduledJobs jobs;
    AddJobs(collection, jobs, "/etc/crontab", &ReadSystemTable);
    AddJobs(collection, jobs, "/etc/anacrontab", &ReadAnacrontab, "root");
    for (const TFolderEntry& entry : FilesIn(collection, "/etc/cron.d")) {
        AddJobs(collection, jobs, "/etc/cron.d/" + entry.name, &ReadSystemTable);
    }
    // Debian keeps the tables of users in a folder of the other systems' folder.
    for (const std::string folder : {"/var/spool/cron", "/var/spool/cron/crontabs"}) {
        for (const TFolderEntry& entry : FilesIn(collection, folder, true)) {
            AddJobs(collection, jobs, folder + "/" + entry.name, &ReadUserTable, entry.name);
        }
    }
    for (const char* const period : {"hourly", "daily", "weekly", "monthly"}) {
        AddScripts(collection, jobs, period);
    }
    AddTimers(collection, jobs);
    jobs.WriteTo(collection);
}

}  // namespace NORVZEL20
