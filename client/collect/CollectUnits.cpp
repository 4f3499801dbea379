// systemd units: what their files say, and what the service manager says of those that it has loaded.
//
// Without an answer of the service manager, a service is active if its control group has processes; nothing is known of other
// units.
//
// Some services run for a moment whenever something else asks for them: a timer, a path, a socket, or a program that calls them by
// their bus name. Whether one of them runs just now is chance, so it has no state unless it has failed. Many services that always
// run have a socket or a bus name too; they can be enabled, or a target wants them.
//
// Units that programs make for a session or a command are left out: those with a file for the time of their run, and those without
// a file that have such a name. A unit with a file of its own stays, whatever its name.

#include <map>
#include <set>

#include "client/collect/CollectKinds.h"
#include "client/collect/MatchesAny.h"
#include "client/collect/TUnitFiles.h"
#include "client/collect/read/TextPieces.h"

namespace NORVZEL20 {

namespace {

constexpr int kMostSlices = 8;  // within each other

// Names of units without a file.
constexpr const char* kPassingUnits[] = {
    "run-*",
    "session-*",
    "user@*",
    "user-runtime-dir@*",
    "systemd-coredump@*",
    "systemd-fsck@*",
    "systemd-backlight@*",
    "blockdev@dev-*.target",
    "modprobe@*.service",
    "*-*-*-*-*-*.service",
};

using TUnitStates = std::map<std::string, TUnitState>;

bool IsPassingUnit(const std::string& name)
{
    return MatchesAny(name, kPassingUnits);
}

// Whether it serves one connection of a socket: echo@0-192.0.2.7:2222-192.0.2.9:33848.service of echo.socket.
bool IsOfConnection(const std::string& name, const std::map<std::string, TUnit>& units)
{
    return fnmatch("*@[0-9]*-*-*.service", name.c_str(), 0) == 0 && units.count(name.substr(0, name.find('@')) + ".socket") > 0;
}

bool HasProcesses(const TCollection& collection, const std::string& group)
{
    const std::string events = collection.GetRoot().Read(group + "/cgroup.events").text;
    return events.find("populated 1") != std::string::npos || !collection.ReadValue(group + "/cgroup.procs").empty();
}

void AddRunningServices(const TCollection& collection, const std::string& slice, int depth, TUnitStates& states)
{
    for (const TFolderEntry& entry : collection.GetRoot().List(slice)) {
        const std::string group = slice + "/" + entry.name;
        if (EndsWith(entry.name, ".slice") && depth < kMostSlices) {
            AddRunningServices(collection, group, depth + 1, states);
        } else if (EndsWith(entry.name, ".service") && HasProcesses(collection, group)) {
            TUnitState state;
            state.name = entry.name;
            state.activeState = "active";
            states.emplace(entry.name, state);
        }
    }
}

class TUnitStateSource {
  public:
    explicit TUnitStateSource(TCollection& collection)
    {
        if (!collection.GetRoot().Look("/run/systemd/system")) {
            collection.LeaveOut("the states of units", "systemd does not run");
            return;
        }
        std::string trouble;
        if (const std::optional<std::vector<TUnitState>> states = collection.GetCalls().UnitStates(trouble)) {
            fKnowsAll = true;
            for (const TUnitState& state : *states) {
                fStates.emplace(state.name, state);
            }
            return;
        }
        for (const char* const slice :
             {"/sys/fs/cgroup/system.slice", "/sys/fs/cgroup/systemd/system.slice", "/sys/fs/cgroup/unified/system.slice"}) {
            fKnowsServices |= collection.GetRoot().Look(slice).has_value();
            AddRunningServices(collection, slice, 0, fStates);
        }
        collection.LeaveOut(fKnowsServices ? "the states of units other than services" : "the states of units", trouble);
    }

    const TUnitStates& GetStates() const noexcept { return fStates; }

    // A unit that is not loaded is inactive. Nothing if the state is not known.
    std::optional<TUnitState> Find(const std::string& name) const
    {
        const auto found = fStates.find(name);
        if (found != fStates.end()) {
            return found->second;
        }
        if (!fKnowsAll && !(fKnowsServices && EndsWith(name, ".service"))) {
            return std::nullopt;
        }
        TUnitState state;
        state.activeState = "inactive";
        return state;
    }

  private:
    TUnitStates fStates;
    bool fKnowsAll = false;
    bool fKnowsServices = false;
};

// Whether neither a link nor a setting starts the unit with the system.
bool IsStartedByOthersOnly(const TUnit& unit)
{
    return !unit.isWanted && (unit.state == "static" || (unit.state == "indirect" && !unit.file.isInstalled));
}

// The units that come and go as others ask for them.
std::set<std::string> UnitsOnDemand(const std::map<std::string, TUnit>& units)
{
    std::set<std::string> names;
    std::set<std::string> called;  // by a socket or by bus name
    for (const auto& [name, unit] : units) {
        if (EndsWith(name, ".timer") || EndsWith(name, ".path")) {
            names.insert(unit.Activated(name));
        } else if (EndsWith(name, ".socket")) {
            called.insert(unit.Activated(name));
        } else if (unit.file.type == "dbus" || (unit.file.type.empty() && unit.file.hasBusName)) {
            called.insert(name);
        }
    }
    for (const std::string& name : called) {
        const auto unit = units.find(name);
        if (unit != units.end() && IsStartedByOthersOnly(unit->second)) {
            names.insert(name);
        }
    }
    return names;
}

void AddState(TFacts& facts, const TUnitState& state, bool isOnDemand)
{
    if (!isOnDemand || state.activeState == "failed") {
        facts.Text("ActiveState", state.activeState).Text("SubState", state.subState);
    }
}

}  // namespace

void CollectUnits(TCollection& collection)
{
    const TUnitFiles& files = collection.GetUnitFiles();
    const TUnitStateSource states(collection);
    const std::set<std::string> onDemand = UnitsOnDemand(files.GetUnits());
    for (const auto& [name, unit] : files.GetUnits()) {
        if (unit.state == TUnit::kTransient) {
            continue;
        }
        TFacts facts("KALMO_Unit");
        facts.Key("Name", name)
            .Text("Description", unit.file.description)
            .Text("UnitFileState", unit.state)
            .Text("File", unit.path)
            .Texts("DropIns", unit.dropIns);
        const std::optional<TUnitState> state = states.Find(name);
        // A template never runs, and the state of another name is that of the unit.
        const bool hasState = name.find("@.") == std::string::npos && unit.state != "alias";
        if (state && hasState) {
            AddState(facts, *state, onDemand.count(name) > 0);
        }
        collection.Add(facts);
    }
    for (const auto& [name, state] : states.GetStates()) {
        if (files.GetUnits().count(name) == 0 && TUnitFiles::IsUnitName(name) && !IsPassingUnit(name) &&
            !IsOfConnection(name, files.GetUnits())) {
            TFacts facts("KALMO_Unit");
            facts.Key("Name", name).Text("Description", state.description);
            AddState(facts, state, false);
            collection.Add(facts);
        }
    }
}

}  // namespace NORVZEL20
