#include <gtest/gtest.h>

#include "client/collect/read/ReadAccounts.h"
#include "tests/client/collect/FactsText.h"

namespace NORVZEL20 {

TEST(AccountsTest, UsersHaveTheirFieldsWithoutThePassword)
{
    EXPECT_EQ("User: Name=root UserID=0 GroupID=0 Description=root HomeDirectory=/root LoginShell=/bin/bash\n"
              "User: Name=_apt UserID=42 GroupID=65534 HomeDirectory=/nonexistent LoginShell=/usr/sbin/nologin\n"
              "User: Name=ftp UserID=14 GroupID=50 HomeDirectory=/var/ftp\n",
              ReadText(&ReadUsers, "root:x:0:0:root:/root:/bin/bash\n"
                                   "\n"
                                   "# a comment\n"
                                   "_apt:x:42:65534::/nonexistent:/usr/sbin/nologin\n"
                                   "+@admins::::::\n"
                                   "-nobody:x:1:1:::\n"
                                   "ftp:$6$secret:14:50::/var/ftp:"));
}

TEST(AccountsTest, GroupsHaveTheirMembers)
{
    EXPECT_EQ("Group: Name=root GroupID=0 Members={}\n"
              "Group: Name=adm GroupID=4 Members={\"syslog\", \"web\"}\n",
              ReadText(&ReadGroups, "root:x:0:\nadm:x:4:syslog,web\n"));
}

TEST(AccountsTest, SubordinateNumbersAreThoseOfAUser)
{
    TReadFaults faults;
    std::string text;
    for (const auto& [name, ranges] : ReadSubordinateNumbers("web:100000:65536\nadm:1:2\nweb:300000:5\n7:x:2\n7:5\n", faults)) {
        text += name;
        for (const std::string& range : ranges) {
            text += " " + range;
        }
        text += "\n";
    }
    EXPECT_EQ("7 x:2\nadm 1:2\nweb 100000:65536 300000:5\n", text);
    EXPECT_EQ("line 5: found 2 fields, expected 3", faults.GetFirst());
}

TEST(AccountsTest, BadLinesAreLeftOutAndTheFirstIsDescribed)
{
    const struct {
        const char* text;
        const char* result;
    } rows[] = {
        {"root:x:0:0:root:/root\n", "1 bad: line 1: found 6 fields, expected 7\n"},
        {"a:b\na\n", "2 bad: line 1: found 2 fields, expected 7\n"},
        {"\nroot:x:zero:0:root:/root:/bin/sh\n",
         "1 bad: line 2: found the name \"root\" with the number \"zero\", expected a name and a number\n"},
        {":x:0:0:root:/root:/bin/sh\n", "1 bad: line 1: found the name \"\" with the number \"0\", expected a name and a number\n"},
        {"root:x:-1:0:root:/root:/bin/sh\n",
         "1 bad: line 1: found the name \"root\" with the number \"-1\", expected a name and a number\n"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.result, ReadText(&ReadUsers, row.text)) << row.text;
    }
}

TEST(AccountsTest, BytesThatAreNoTextAreWrittenAsHexadecimalDigits)
{
    EXPECT_EQ("User: Name=j\\xF6rg UserID=1 GroupID=1 Description=bell\\x07 HomeDirectory=/ö LoginShell=/\\xEF\\xBF\\xBE\n",
              ReadText(&ReadUsers, "j\xF6rg:x:1:1:bell\x07:/ö:/\xEF\xBF\xBE\n"));
}

}  // namespace NORVZEL20
