#include <gtest/gtest.h>

#include "client/collect/read/ReadCrontab.h"
#include "client/collect/read/ReadOsRelease.h"
#include "client/collect/read/ReadUnitFile.h"

namespace NORVZEL20 {

namespace {

std::string JobsText(const std::vector<TJob>& jobs, const TReadFaults& faults)
{
    std::string text;
    for (const TJob& job : jobs) {
        text += job.schedule + "|" + job.user + "|" + job.command + "\n";
    }
    return faults.GetCount() == 0 ? text : text + std::to_string(faults.GetCount()) + " bad: " + faults.GetFirst() + "\n";
}

std::string CrontabText(const std::string& text, bool hasUsers)
{
    TReadFaults faults;
    const std::vector<TJob> jobs = ReadCrontab(text, hasUsers, faults);
    return JobsText(jobs, faults);
}

std::string UnitText(const std::vector<std::string>& texts)
{
    TUnitFile unit;
    for (const std::string& text : texts) {
        ReadUnitFile(text, unit);
    }
    std::string result = unit.description + "|" + unit.type + "|" + unit.activated + "|" + (unit.isInstalled ? "installed" : "") +
                         (unit.isInstalledByOthers ? "by others" : "");
    for (const std::string& schedule : unit.schedules) {
        result += "|" + schedule;
    }
    return result;
}

}  // namespace

TEST(CrontabTest, JobsOfTheSystemHaveAUser)
{
    EXPECT_EQ("17 * * * *|root|cd / && run-parts --report /etc/cron.hourly\n"
              "*/5 0-23 1,15 * mon-fri|www-data|[ -x /usr/bin/php ] && X=1 php job\n"
              "@reboot|root|/usr/local/bin/tidy\n",
              CrontabText("# comment\n"
                          "SHELL=/bin/sh\n"
                          "PATH = /usr/sbin:/usr/bin\n"
                          "\n"
                          "17 *\t* * *\troot\tcd / && run-parts --report /etc/cron.hourly\n"
                          "*/5 0-23 1,15 * mon-fri www-data [ -x /usr/bin/php ] && X=1 php job\n"
                          "@reboot root /usr/local/bin/tidy",
                          true));
}

TEST(CrontabTest, JobsOfAUserHaveNone)
{
    EXPECT_EQ("0 5 * * 1||tar -zcf /var/backups/home.tgz /home/\n@daily||backup\n",
              CrontabText("MAILTO=web\n0 5 * * 1 tar -zcf /var/backups/home.tgz /home/\n@daily backup\n", false));
}

TEST(CrontabTest, LinesThatEndEarlyAreLeftOut)
{
    const struct {
        const char* line;
        bool hasUsers;
        const char* expected;
    } rows[] = {
        {"17 * * *", true, "a schedule, a user and a command"},    {"17 * * * * root", true, "a schedule, a user and a command"},
        {"@daily root", true, "a schedule, a user and a command"}, {"17 * * * *", false, "a schedule and a command"},
        {"root run-parts", false, "a schedule and a command"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ("1 bad: line 1: found no job, expected " + std::string(row.expected) + "\n", CrontabText(row.line, row.hasUsers))
            << row.line;
    }
}

TEST(CrontabTest, AnacronNamesPeriodAndDelay)
{
    TReadFaults faults;
    const std::vector<TJob> jobs = ReadAnacrontab("START_HOURS_RANGE=3-22\n1\t5\tcron.daily\trun-parts /etc/cron.daily\n"
                                                  "@monthly 45 cron.monthly run-parts /etc/cron.monthly\n7 25\n",
                                                  faults);
    EXPECT_EQ("1 5||run-parts /etc/cron.daily\n@monthly 45||run-parts /etc/cron.monthly\n"
              "1 bad: line 4: found no job, expected a period, a delay, a name and a command\n",
              JobsText(jobs, faults));
}

TEST(UnitFileTest, SectionsSayWhatAUnitIs)
{
    EXPECT_EQ("OpenBSD Secure Shell server|notify||installed",
              UnitText({"[Unit]\nDescription=OpenBSD Secure Shell server\n\n[Service]\nType=notify\nDescription=no\n"
                        "[Install]\nWantedBy=multi-user.target\nAlias=sshd.service\n"}));
    EXPECT_EQ("|oneshot||", UnitText({"# [Install]\n; WantedBy=x\n[Service]\n Type = oneshot \n[Install]\nWantedBy=\n"}));
    EXPECT_EQ("|||by others", UnitText({"[Install]\nAlso=other.service\n"}));
    EXPECT_EQ("Daily|||installed|OnCalendar=*-*-* 6,18:00|OnBootSec=15min",
              UnitText({"[Unit]\nDescription=Daily\n[Timer]\nOnCalendar=*-*-* "
                        "6,18:00\nOnBootSec=15min\nPersistent=true\n[Install]\nWantedBy=timers.target\n"}));
    EXPECT_EQ("a b||x.service|", UnitText({"[Unit]\nDescription=a\\\n b\n[Path]\nUnit=x.service\nPathExists=/x"}));
}

TEST(UnitFileTest, DropInsChangeWhatTheFileSays)
{
    EXPECT_EQ("New|||installed|OnCalendar=weekly",
              UnitText({"[Unit]\nDescription=Old\n[Timer]\nOnCalendar=daily\n[Install]\nWantedBy=timers.target\n",
                        "[Unit]\nDescription=New\n[Timer]\nOnCalendar=\nOnCalendar=weekly\n"}));
}

TEST(UnitFileTest, TextThatIsNoUnitSaysNothing)
{
    EXPECT_EQ("|||", UnitText({""}));
    EXPECT_EQ("|||", UnitText({"Description=outside\n=\n[\n]\n\\\n\\"}));
}

TEST(OsReleaseTest, ValuesAreUnquoted)
{
    std::string text;
    for (const auto& [name, value] :
         ReadOsRelease("NAME=\"Rocky Linux\"\n# no\nID='rocky'\nVERSION_ID=9\\.3\nX=\"a \\\"b\\\" \\$\"\nbad\n")) {
        text += name + "=" + value + "|";
    }
    EXPECT_EQ("ID=rocky|NAME=Rocky Linux|VERSION_ID=9.3|X=a \"b\" $|", text);
}

}  // namespace NORVZEL20
