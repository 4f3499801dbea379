// Tables of cron and anacron. A line is a comment, an assignment to a variable, or a job:
//
//   17 * * * * root run-parts /etc/cron.hourly      minute hour day month weekday [user] command
//   @reboot root /usr/local/bin/tidy                a word for the five fields
//   7 25 cron.weekly run-parts /etc/cron.weekly     anacron: period in days, delay in minutes, name, command
#include "client/collect/read/ReadCrontab.h"

#include "client/collect/read/TTextLines.h"
#include "client/collect/read/TextPieces.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kCronFields = 5;

// Takes the next word off the text.
std::string_view TakeWord(std::string_view& text)
{
    text = Trimmed(text);
    const std::string_view word = text.substr(0, text.find_first_of(" \t"));
    text.remove_prefix(word.size());
    return word;
}

// Takes words off the text and joins them.
std::string TakeWords(std::string_view& text, std::size_t count)
{
    std::string words;
    for (std::size_t i = 0; i < count; ++i) {
        words += (i == 0 ? "" : " ") + std::string(TakeWord(text));
    }
    return words;
}

// NAME=value or NAME = value. A job's first word begins with a digit, an asterisk or an at sign.
bool IsAssignment(std::string_view line)
{
    const std::size_t equals = line.find('=');
    if (equals == std::string_view::npos) {
        return false;
    }
    const std::string_view name = Trimmed(line.substr(0, equals));
    return name.find_first_of(" \t*") == std::string_view::npos && !name.empty() && name[0] != '@';
}

bool IsSchedule(std::string_view line)
{
    return line[0] == '@' || line[0] == '*' || line[0] == '~' || (line[0] >= '0' && line[0] <= '9');
}

template <class TTake>
std::vector<TJob> ReadJobs(std::string_view text, const char* expected, TReadFaults& faults, TTake take)
{
    std::vector<TJob> jobs;
    TTextLines lines(text);
    while (lines.Next()) {
        const std::string_view line = Trimmed(lines.GetLine());
        if (line.empty() || line[0] == '#' || IsAssignment(line)) {
            continue;
        }
        const TJob job = IsSchedule(line) ? take(line) : TJob();
        if (job.command.empty()) {
            // The line is not shown: it may hold a password.
            faults.Add(lines.GetNumber(), std::string("found no job, expected ") + expected);
        } else {
            jobs.push_back(job);
        }
    }
    return jobs;
}

}  // namespace

std::vector<TJob> ReadCrontab(std::string_view text, bool hasUsers, TReadFaults& faults)
{
    const char* const expected = hasUsers ? "a schedule, a user and a command" : "a schedule and a command";
    return ReadJobs(text, expected, faults, [hasUsers](std::string_view line) {
        TJob job;
        job.schedule = TakeWords(line, line[0] == '@' ? 1 : kCronFields);
        job.user = hasUsers ? std::string(TakeWord(line)) : std::string();
        job.command = std::string(Trimmed(line));
        return job;
    });
}

std::vector<TJob> ReadAnacrontab(std::string_view text, TReadFaults& faults)
{
    return ReadJobs(text, "a period, a delay, a name and a command", faults, [](std::string_view line) {
        TJob job;
        job.schedule = TakeWords(line, 2);
        TakeWord(line);
        job.command = std::string(Trimmed(line));
        return job;
    });
}

}  // namespace NORVZEL20
