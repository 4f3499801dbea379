// The lists of users and groups: a line each, with fields between colons.
//
//   passwd   name:password:number:number of the group:description:home:shell
//   group    name:password:number:member,member
//   subuid   name:first number:how many numbers
//
// A line that begins with + or - includes another source of accounts (NIS) and is no account.
#include "client/collect/read/ReadAccounts.h"

#include <functional>

#include "client/collect/read/TTextLines.h"
#include "client/collect/read/TextPieces.h"
#include "client/text/NumberIn.h"

namespace NORVZEL20 {

namespace {

using TAccountFields = std::vector<std::string_view>;

// Calls `take` with the fields of each line that has `count` of them, a name and a number.
void ForEachAccount(std::string_view text, std::size_t count, TReadFaults& faults,
                    const std::function<void(const TAccountFields&)>& take)
{
    TTextLines lines(text);
    while (lines.Next()) {
        const std::string_view line = Trimmed(lines.GetLine());
        if (line.empty() || line[0] == '#' || line[0] == '+' || line[0] == '-') {
            continue;
        }
        const TAccountFields fields = SplitAt(line, ':');
        if (fields.size() != count) {
            faults.Add(lines.GetNumber(), "found " + std::to_string(fields.size()) + (fields.size() == 1 ? " field" : " fields") +
                                              ", expected " + std::to_string(count));
        } else if (fields[0].empty() || !NumberIn(fields[2])) {
            faults.Add(lines.GetNumber(), "found the name " + Quoted(fields[0]) + " with the number " + Quoted(fields[2]) +
                                              ", expected a name and a number");
        } else {
            take(fields);
        }
    }
}

}  // namespace

TSubordinateNumbers ReadSubordinateNumbers(std::string_view text, TReadFaults& faults)
{
    TSubordinateNumbers numbers;
    ForEachAccount(text, 3, faults, [&numbers](const TAccountFields& fields) {
        numbers[std::string(fields[0])].push_back(std::string(fields[1]) + ":" + std::string(fields[2]));
    });
    return numbers;
}

std::vector<TFacts> ReadUsers(std::string_view text, TReadFaults& faults)
{
    std::vector<TFacts> users;
    ForEachAccount(text, 7, faults, [&users](const TAccountFields& fields) {
        users.push_back(TFacts("KALMO_User")
                            .Key("Name", fields[0])
                            .Text("UserID", fields[2])
                            .Text("GroupID", fields[3])
                            .Text("Description", fields[4])
                            .Text("HomeDirectory", fields[5])
                            .Text("LoginShell", fields[6]));
    });
    return users;
}

std::vector<TFacts> ReadGroups(std::string_view text, TReadFaults& faults)
{
    std::vector<TFacts> groups;
    ForEachAccount(text, 4, faults, [&groups](const TAccountFields& fields) {
        groups.push_back(
            TFacts("KALMO_Group").Key("Name", fields[0]).Text("GroupID", fields[2]).Texts("Members", ListOf(fields[3], ',')));
    });
    return groups;
}

}  // namespace NORVZEL20
