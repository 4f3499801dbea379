#include <gtest/gtest.h>

#include "client/collect/read/TextPieces.h"
#include "tests/client/collect/TCollectFixture.h"

namespace NORVZEL20 {

class UnitsTest : public TCollectFixture {
  protected:
    TMadeSystem& Unit(const std::string& path, const std::string& text) { return fSystem->File(path, text); }

    /// A line for each unit: name, state of its file, active state.
    std::string States()
    {
        std::string text;
        for (const std::string& line : ListOf(Show("KALMO_Unit"), '\n')) {
            if (StartsWith(line, "Name: ")) {
                text += (text.empty() ? "" : "\n") + line.substr(6);
            } else if (StartsWith(line, "UnitFileState: ") || StartsWith(line, "ActiveState: ")) {
                text += " " + line.substr(line.find(':') + 2);
            }
        }
        return text + "\n";
    }
};

TEST_F(UnitsTest, FilesAndLinksDecideWhetherAUnitIsEnabled)
{
    const std::string lib = "/usr/lib/systemd/system/";
    const std::string etc = "/etc/systemd/system/";
    const std::string installed = "[Install]\nWantedBy=multi-user.target\n";
    Unit(lib + "a-disabled.service", installed);
    Unit(lib + "b-static.service", "[Service]\n");
    Unit(lib + "c-masked.service", installed).Link(etc + "c-masked.service", "/dev/null");
    Unit(lib + "d-empty.service", installed).File("/run/systemd/system/d-empty.service", "");
    Unit(lib + "e@.service", installed).Link(etc + "getty.target.wants/e@tty1.service", lib + "e@.service");
    Unit(lib + "f.service", installed).Link(etc + "f-alias.service", lib + "f.service");
    Unit(lib + "f2.service", installed + "Alias=f3.service f4.service\n").Link(etc + "f4.service", lib + "f2.service");
    Unit(lib + "g.service", installed).Link("/run/systemd/system/x.target.requires/g.service", lib + "g.service");
    Unit("/run/systemd/generator/h.service", "[Service]\n");
    Unit(lib + "i.service", "[Install]\nAlso=f.service\n");
    Unit(lib + "j.mount", "");
    EXPECT_EQ("a-disabled.service disabled inactive\n"
              "b-static.service static inactive\n"
              "c-masked.service masked inactive\n"
              "d-empty.service masked-runtime inactive\n"
              "e@.service indirect NULL\n"
              "e@tty1.service enabled inactive\n"
              "f-alias.service alias NULL\n"
              "f.service indirect inactive\n"
              "f2.service enabled inactive\n"
              "f4.service alias NULL\n"
              "g.service enabled-runtime inactive\n"
              "h.service generated inactive\n"
              "i.service indirect inactive\n"
              "ssh.service enabled active\n",
              States());
}

/// As "systemctl list-unit-files" says it of the same files.
TEST_F(UnitsTest, TemplatesAndLinkedFilesHaveTheStatesOfSystemd)
{
    const std::string lib = "/usr/lib/systemd/system/";
    const std::string etc = "/etc/systemd/system/";
    const std::string wants = etc + "multi-user.target.wants/";
    const std::string installed = "[Install]\nWantedBy=multi-user.target\n";
    const std::string first = installed + "DefaultInstance=tty1\n";
    Unit(lib + "d@.service", first).Link(wants + "d@tty1.service", lib + "d@.service");
    Unit(lib + "dd@.service", first).Link(wants + "dd@tty2.service", lib + "dd@.service");
    Unit(lib + "s@.service", "[Service]\n").Link(wants + "s@tty2.service", lib + "s@.service");
    Unit(lib + "la.service", "[Service]\n").Link(lib + "la-alias.service", "la.service");
    Unit(lib + "w.service", installed).Link(wants + "other.service", lib + "w.service");
    Unit("/opt/x/le.service", installed)
        .Link(etc + "le.service", "/opt/x/le.service")
        .Link(wants + "le.service", "/opt/x/le.service");
    Unit("/opt/x/lk.service", installed).Link(etc + "lk.service", "/opt/x/lk.service");
    Unit("/opt/x/ls.service", "")
        .Link("/run/systemd/system/ls.service", "/opt/x/ls.service")
        .Append("/opt/x/ls.service", "[Unit]\n");
    EXPECT_EQ("d@.service enabled NULL\n"
              "d@tty1.service enabled inactive\n"
              "dd@.service indirect NULL\n"
              "dd@tty2.service enabled inactive\n"
              "la-alias.service alias NULL\n"
              "la.service static inactive\n"
              "le.service enabled inactive\n"
              "lk.service linked inactive\n"
              "ls.service linked-runtime inactive\n"
              "s@.service indirect NULL\n"
              "s@tty2.service enabled inactive\n"
              "ssh.service enabled active\n"
              "w.service disabled inactive\n",
              States());
}

TEST_F(UnitsTest, LinksOfGeneratorsEnableUntilTheNextStart)
{
    const std::string lib = "/usr/lib/systemd/system/";
    const std::string generated = "/run/systemd/generator/";
    Unit(lib + "fsck-root.service", "[Service]\n")
        .Link(generated + "local-fs.target.wants/fsck-root.service", lib + "fsck-root.service");
    Unit(lib + "serial@.service", "[Install]\nWantedBy=getty.target\n")
        .Link(generated + "getty.target.wants/serial@ttyS0.service", lib + "serial@.service");
    Unit("/run/systemd/generator.late/old.service", "[Service]\n")
        .Link("/run/systemd/generator.late/multi-user.target.wants/old.service", "../old.service");
    EXPECT_EQ("fsck-root.service enabled-runtime inactive\n"
              "old.service generated inactive\n"
              "serial@.service indirect NULL\n"
              "serial@ttyS0.service enabled-runtime inactive\n"
              "ssh.service enabled active\n",
              States());
}

TEST_F(UnitsTest, MaskedUnitKeepsItsDescription)
{
    EXPECT_EQ(
        "KALMO_ConfigurationFile  + /etc/systemd/system/ssh.service   Type link, Owner root, Group root, LinkTarget /dev/null\n"
        "KALMO_Unit               ~ ssh.service.File: /usr/lib/systemd/system/ssh.service -> /etc/systemd/system/ssh.service\n"
        "                         ~ ssh.service.UnitFileState: enabled -> masked\n",
        FoundAfter([](TMadeSystem& system) { system.Link("/etc/systemd/system/ssh.service", "/dev/null"); }));
}

TEST_F(UnitsTest, UnitWhoseFileCannotBeReadHasNoStateOfItsFile)
{
    fSystem->Link("/etc/systemd/system/gone.service", "/opt/gone/gone.service");
    fSystem->Link("/etc/systemd/system/on.service", "/opt/gone/on.service");
    fSystem->Link("/etc/systemd/system/multi-user.target.wants/on.service", "/opt/gone/on.service");
    EXPECT_EQ("gone.service NULL inactive\non.service enabled inactive\nssh.service enabled active\n", States());
    EXPECT_EQ("not collected: files: /etc/shadow: it may hold keys or passwords\n"
              "not collected: units: /etc/systemd/system/gone.service, /etc/systemd/system/on.service: No such file or directory\n",
              fLines);
}

TEST_F(UnitsTest, UnitsOnDemandHaveAStateOnlyIfTheyFailed)
{
    Unit("/usr/lib/systemd/system/tidy.timer", "[Timer]\nOnCalendar=daily\n");
    Unit("/usr/lib/systemd/system/tidy.service", "[Service]\nType=oneshot\n");
    Unit("/usr/lib/systemd/system/host.service", "[Service]\nType=dbus\n");
    fSystem->fCalls.fUnits->push_back({"tidy.service", "", "activating", "start"});
    fSystem->fCalls.fUnits->push_back({"host.service", "", "failed", "failed"});
    EXPECT_EQ("host.service static failed\nssh.service enabled active\ntidy.service static NULL\ntidy.timer static inactive\n",
              States());
}

TEST_F(UnitsTest, ServicesOfSocketsAndCallsAreOnDemandUnlessSomethingWantsThem)
{
    const std::string lib = "/usr/lib/systemd/system/";
    const std::string installed = "[Install]\nWantedBy=multi-user.target\n";
    const std::string call = "[Service]\nBusName=org.example.Named\n";
    Unit(lib + "a-fsckd.service", "[Service]\n").File(lib + "a-fsckd.socket", "[Socket]\n");
    Unit(lib + "b-other.service", "[Service]\n").File(lib + "b.socket", "[Socket]\nService=b-other.service\n");
    Unit(lib + "c-named.service", call).Link(lib + "dbus-org.example.Named.service", "c-named.service");
    Unit(lib + "d-also.service", "[Install]\nAlso=d-also.socket\n").File(lib + "d-also.socket", "[Socket]\n");
    Unit(lib + "k-simple.service", call + "Type=simple\n");
    Unit(lib + "l-login.service", call).Link(lib + "multi-user.target.wants/l-login.service", "../l-login.service");
    Unit(lib + "m-bus.service", call).Link(lib + "multi-user.target.wants/m-alias.service", "../m-bus.service");
    Unit(lib + "n-journald.service", "[Service]\n")
        .File(lib + "n-journald.socket", "[Socket]\n")
        .Link(lib + "sysinit.target.wants/n-journald.service", "../n-journald.service");
    Unit(lib + "o-print.service", installed).File(lib + "o-print.socket", "[Socket]\n");
    for (const char* name : {"a-fsckd", "b-other", "c-named", "d-also", "k-simple", "l-login", "m-bus", "n-journald", "o-print"}) {
        fSystem->fCalls.fUnits->push_back({name + std::string(".service"), "", "active", "running"});
    }
    EXPECT_EQ("a-fsckd.service static NULL\n"
              "a-fsckd.socket static inactive\n"
              "b-other.service static NULL\n"
              "b.socket static inactive\n"
              "c-named.service static NULL\n"
              "d-also.service indirect NULL\n"
              "d-also.socket static inactive\n"
              "dbus-org.example.Named.service alias NULL\n"
              "k-simple.service static active\n"
              "l-login.service static active\n"
              "m-bus.service static active\n"
              "n-journald.service static active\n"
              "n-journald.socket static inactive\n"
              "o-print.service disabled active\n"
              "o-print.socket static inactive\n"
              "ssh.service enabled active\n",
              States());
}

TEST_F(UnitsTest, UnitsWithoutAFileAreThoseThatAreLoaded)
{
    fSystem->fCalls.fUnits->push_back({"made.service", "Made", "active", "running"});
    fSystem->fCalls.fUnits->push_back({"run-r123.service", "", "active", "running"});
    fSystem->fCalls.fUnits->push_back({"session-1.scope", "", "active", "running"});
    EXPECT_EQ("ssh.service enabled active\nmade.service NULL active\n", States());
}

TEST_F(UnitsTest, UnitsOfOneConnectionDeviceOrModuleAreLeftOut)
{
    Unit("/etc/systemd/system/echo.socket", "[Socket]\nAccept=yes\n");
    Unit("/etc/systemd/system/echo@.service", "[Service]\n");
    for (const char* name : {"echo@0-127.0.0.1:2222-127.0.0.1:33848.service", "echo@17-1234-0.service", "echo@made.service",
                             "backup@2026-11-22.service", "blockdev@dev-vda.target", "modprobe@drm.service"}) {
        fSystem->fCalls.fUnits->push_back({name, "", "active", "running"});
    }
    EXPECT_EQ("echo.socket static inactive\n"
              "echo@.service static NULL\n"
              "ssh.service enabled active\n"
              "backup@2026-11-22.service NULL active\n"
              "echo@made.service NULL active\n",
              States());
}

TEST_F(UnitsTest, UnitsWithAFileStayWhateverTheirName)
{
    Unit("/etc/systemd/system/run-backup.service", "[Service]\n");
    Unit("/etc/systemd/system/a-b-c-d-e-f.service", "[Service]\n");
    Unit("/usr/lib/systemd/system/session-clean.timer", "[Timer]\nOnCalendar=daily\n");
    Unit("/lib/systemd/system/systemd-fsck@.service", "[Service]\n");
    Unit("/run/systemd/transient/backup.service", "[Service]\n");
    fSystem->fCalls.fUnits->push_back({"backup.service", "", "active", "running"});
    fSystem->fCalls.fUnits->push_back({"systemd-fsck@dev-sda1.service", "", "active", "exited"});
    fSystem->fCalls.fUnits->push_back({"run-backup.service", "", "failed", "failed"});
    EXPECT_EQ("a-b-c-d-e-f.service static inactive\n"
              "run-backup.service static failed\n"
              "session-clean.timer static inactive\n"
              "ssh.service enabled active\n"
              "systemd-fsck@.service static NULL\n",
              States());
}

TEST_F(UnitsTest, WithoutAnAnswerServicesWithProcessesAreActive)
{
    fSystem->fCalls.fUnits.reset();
    Unit("/usr/lib/systemd/system/a.service", "").File("/usr/lib/systemd/system/b.socket", "[Socket]\n");
    Unit("/usr/lib/systemd/system/c@.service", "[Service]\n");
    fSystem->File("/sys/fs/cgroup/system.slice/ssh.service/cgroup.events", "populated 1\nfrozen 0\n");
    fSystem->File("/sys/fs/cgroup/system.slice/system-c.slice/c@1.service/cgroup.procs", "17\n");
    EXPECT_EQ("a.service masked inactive\nb.socket static NULL\nc@.service static NULL\nssh.service enabled active\nc@1.service "
              "NULL active\n",
              States());
    EXPECT_NE(std::string::npos,
              fLines.find("units: the states of units other than services: the service manager does not answer\n"))
        << fLines;
}

TEST_F(UnitsTest, WithoutSystemdNoStateIsKnown)
{
    fSystem->Unlink("/run/systemd/system/.keep");
    fSystem->RemoveFolder("/run/systemd/system");
    EXPECT_EQ("ssh.service enabled NULL\n", States());
    EXPECT_NE(std::string::npos, fLines.find("units: the states of units: systemd does not run\n")) << fLines;
}

TEST_F(UnitsTest, TimersThatAreStartedAreJobs)
{
    Unit("/usr/lib/systemd/system/tidy.timer", "[Timer]\nOnCalendar=daily\nOnBootSec=5min\n");
    Unit("/usr/lib/systemd/system/off.timer", "[Timer]\nOnCalendar=daily\n[Install]\nWantedBy=timers.target\n");
    Unit("/usr/lib/systemd/system/x@.timer", "[Timer]\nOnCalendar=daily\n");
    Unit("/opt/own/own.timer", "[Timer]\nOnCalendar=daily\n").Link("/etc/systemd/system/own.timer", "/opt/own/own.timer");
    Unit("/opt/own/now.timer", "[Timer]\nOnCalendar=daily\n").Link("/run/systemd/system/now.timer", "/opt/own/now.timer");
    EXPECT_EQ("KALMO_ScheduledJob.Command=\"run-parts /etc/cron.hourly\",Source=\"/etc/crontab\",User=\"root\"\n"
              "    Source: /etc/crontab\n"
              "    Command: run-parts /etc/cron.hourly\n"
              "    User: root\n"
              "    Schedules: {\"17 * * * *\"}\n"
              "KALMO_ScheduledJob.Command=\"tidy.service\",Source=\"tidy.timer\",User=\"\"\n"
              "    Source: tidy.timer\n"
              "    Command: tidy.service\n"
              "    User: \"\"\n"
              "    Schedules: {\"OnBootSec=5min\", \"OnCalendar=daily\"}\n",
              Show("KALMO_ScheduledJob"));
}

}  // namespace NORVZEL20
