#include "client/collect/CollectKinds.h"
#include "client/collect/read/ReadAccounts.h"

namespace NORVZEL20 {

namespace {

TSubordinateNumbers NumbersIn(TCollection& collection, const std::string& path)
{
    TReadFaults faults;
    TSubordinateNumbers numbers = ReadSubordinateNumbers(collection.ReadIfThere(path).value_or(std::string()), faults);
    collection.LeaveOutLines(path, faults);
    return numbers;
}

// The numbers of a user, whom a file may name by the number.
std::vector<std::string> NumbersOf(const TFacts& user, const TSubordinateNumbers& numbers)
{
    const auto byName = numbers.find(user.Find("Name").ToText());
    const auto found = byName == numbers.end() ? numbers.find(user.Find("UserID").ToText()) : byName;
    return found == numbers.end() ? std::vector<std::string>() : found->second;
}

void AddUsers(TCollection& collection)
{
    const std::string path = "/etc/passwd";
    const std::optional<std::string> text = collection.Read(path);
    if (!text) {
        return;
    }
    const TSubordinateNumbers users = NumbersIn(collection, "/etc/subuid");
    const TSubordinateNumbers groups = NumbersIn(collection, "/etc/subgid");
    TReadFaults faults;
    for (TFacts& user : ReadUsers(*text, faults)) {
        const std::vector<std::string> userNumbers = NumbersOf(user, users);
        const std::vector<std::string> groupNumbers = NumbersOf(user, groups);
        collection.Add(user.Texts("SubordinateUserIDs", userNumbers).Texts("SubordinateGroupIDs", groupNumbers));
    }
    collection.LeaveOutLines(path, faults);
}

}  // namespace

void CollectUsers(TCollection& collection)
{
    AddUsers(collection);
    collection.AddFrom("/etc/group", &ReadGroups);
}

}  // namespace NORVZEL20
