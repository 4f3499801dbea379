// The file of a systemd unit: sections in brackets, and assignments in them. A backslash at the end of a line joins it with the
// next one; an assignment without a value empties a list.
//
//   [Unit]
//   Description=Daily clean-up
//   [Timer]
//   OnCalendar=daily
//   [Install]
//   WantedBy=timers.target
#include "client/collect/read/ReadUnitFile.h"

#include "client/collect/read/TTextLines.h"
#include "client/collect/read/TextPieces.h"

namespace NORVZEL20 {

namespace {

void TakeTimerValue(std::string_view name, std::string_view value, TUnitFile& unit)
{
    if (!StartsWith(name, "On")) {
        return;
    }
    if (value.empty()) {
        unit.schedules.clear();
    } else {
        unit.schedules.push_back(std::string(name) + "=" + std::string(value));
    }
}

void TakeInstallValue(std::string_view name, std::string_view value, TUnitFile& unit)
{
    if (name == "Alias") {
        for (const std::string_view alias : SplitAtBlanks(value)) {
            unit.aliases.emplace_back(alias);
        }
    } else if (name == "DefaultInstance") {
        unit.defaultInstance = std::string(value);
    }
    unit.isInstalled |= name == "WantedBy" || name == "RequiredBy" || name == "UpheldBy" || name == "Alias";
    unit.isInstalledByOthers |= name == "Also";
}

void TakeUnitValue(std::string_view section, std::string_view name, std::string_view value, TUnitFile& unit)
{
    if (section == "[Unit]" && name == "Description") {
        unit.description = std::string(value);
    } else if (section == "[Service]" && name == "Type") {
        unit.type = std::string(value);
    } else if (section == "[Service]" && name == "BusName") {
        unit.hasBusName = !value.empty();
    } else if (((section == "[Timer]" || section == "[Path]") && name == "Unit") || (section == "[Socket]" && name == "Service")) {
        unit.activated = std::string(value);
    } else if (section == "[Timer]") {
        TakeTimerValue(name, value, unit);
    } else if (section == "[Install]" && !value.empty()) {
        TakeInstallValue(name, value, unit);
    }
}

}  // namespace

void ReadUnitFile(std::string_view text, TUnitFile& unit)
{
    std::string section;
    std::string joined;
    TTextLines lines(text);
    while (lines.Next()) {
        const std::string_view line = Trimmed(lines.GetLine());
        if (StartsWith(line, "#") || StartsWith(line, ";")) {
            continue;
        }
        if (EndsWith(line, "\\")) {
            joined += std::string(line.substr(0, line.size() - 1)) + " ";
            continue;
        }
        const std::string whole = joined + std::string(line);
        joined.clear();
        const std::size_t equals = whole.find('=');
        if (StartsWith(whole, "[")) {
            section = whole;
        } else if (equals != std::string::npos) {
            const std::string_view assignment = whole;
            TakeUnitValue(section, Trimmed(assignment.substr(0, equals)), Trimmed(assignment.substr(equals + 1)), unit);
        }
    }
}

}  // namespace NORVZEL20
