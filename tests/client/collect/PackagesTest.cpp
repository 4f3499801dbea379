#include <gtest/gtest.h>

#include "client/collect/read/ReadDpkgStatus.h"
#include "client/collect/read/ReadRpmHeader.h"
#include "tests/client/collect/FactsText.h"
#include "tests/client/collect/TRpmHeaderBuilder.h"

namespace NORVZEL20 {

namespace {

std::string RpmText(const std::string& bytes)
{
    TRpmPackage package;
    std::string trouble;
    if (!ReadRpmHeader(bytes, package, trouble)) {
        return trouble;
    }
    return package.name + " " + package.version + " " + package.architecture + " " + package.source + " " + package.vendor;
}

}  // namespace

TEST(DpkgStatusTest, PackagesHaveVersionAndState)
{
    EXPECT_EQ(
        "Package: Name=openssh-server Architecture=amd64 Manager=dpkg Version=1:9.2p1-2+deb12u10 State=installed Selection=install "
        "Source=openssh\n"
        "Package: Name=nginx Architecture=all Manager=dpkg Version=1.22.1-9 State=config-files Selection=deinstall\n"
        "Package: Name=e2fsprogs Architecture=amd64 Manager=dpkg Version=1.47.0-2+b2 State=installed Selection=install\n"
        "Package: Name=linux-image Architecture=amd64 Manager=dpkg Version=6.1 State=half-installed (reinstreq) Selection=hold "
        "Source=linux\n",
        ReadText(&ReadDpkgStatus, "Package: openssh-server\n"
                                  "Status: install ok installed\n"
                                  "Priority: optional\n"
                                  "Architecture: amd64\n"
                                  "Source: openssh\n"
                                  "Version: 1:9.2p1-2+deb12u10\n"
                                  "Conffiles:\n"
                                  " /etc/default/ssh 8f27a8fb6a2c2e5a9e2bd3bb9a6a4d9f\n"
                                  " Version: 9 is no field here\n"
                                  "Description: secure shell (SSH) server\n"
                                  "\n"
                                  "Package: nginx\n"
                                  "Status: deinstall ok config-files\n"
                                  "Architecture: all\n"
                                  "Version: 1.22.1-9\n"
                                  "\n"
                                  "\n"
                                  "Package: gone\n"
                                  "Status: unknown ok not-installed\n"
                                  "Architecture: amd64\n"
                                  "\n"
                                  "Package: e2fsprogs\n"
                                  "Status: install ok installed\n"
                                  "Architecture: amd64\n"
                                  "Source: e2fsprogs (1.47.0-2)\n"
                                  "Version: 1.47.0-2+b2\n"
                                  "\n"
                                  "Package: linux-image\n"
                                  "Status: hold reinstreq half-installed\n"
                                  "Architecture: amd64\n"
                                  "Source: linux (6.1.0-1)\n"
                                  "Version: 6.1\n"));
}

TEST(DpkgStatusTest, WhatIsDamagedIsLeftOut)
{
    const struct {
        const char* text;
        const char* result;
    } rows[] = {
        {"", ""},
        {"\n\n", ""},
        {"Package: a\nStatus: install ok installed\nArchitecture: all\nVersion: 1",
         "1 bad: line 4: found the end of the file, expected the rest of the line\n"},
        {"Package: a\nStatus: install ok installed\nArchitecture: all\n",
         "1 bad: line 1: found no version or no architecture of a, expected both\n"},
        {"\nPackage: a\nStatus: installed\n", "1 bad: line 2: found the status \"installed\" of a, expected three words\n"},
        {"Status: install ok installed\n", "1 bad: line 1: found a package without a name, expected the field Package\n"},
        {"Package: a\nStatus: install ok installed\nArchitecture: all\nVersion: 1\nrubbish\n",
         "Package: Name=a Architecture=all Manager=dpkg Version=1 State=installed Selection=install\n"
         "1 bad: line 5: found \"rubbish\", expected a field and its value\n"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.result, ReadText(&ReadDpkgStatus, row.text)) << row.text;
    }
}

TEST(RpmHeaderTest, HeaderHasNameVersionAndArchitecture)
{
    EXPECT_EQ("bash 5.1.8-9.el9 x86_64 bash-5.1.8-9.el9.src.rpm Rocky", RpmText(TRpmHeaderBuilder()
                                                                                    .Text(1000, "bash")
                                                                                    .Text(1001, "5.1.8")
                                                                                    .Text(1002, "9.el9")
                                                                                    .Text(1011, "Rocky")
                                                                                    .Text(1022, "x86_64")
                                                                                    .Text(1044, "bash-5.1.8-9.el9.src.rpm")
                                                                                    .GetBytes()));
    EXPECT_EQ("gpg-pubkey 8483c65d-5ccc5b19 (none)  ",
              RpmText(TRpmHeaderBuilder().Text(1000, "gpg-pubkey").Text(1001, "8483c65d").Text(1002, "5ccc5b19").GetBytes()));
    EXPECT_EQ("bind 32:9.16-1 x86_64  ", RpmText(TRpmHeaderBuilder()
                                                     .Text(1000, "bind")
                                                     .Text(1001, "9.16")
                                                     .Text(1002, "1")
                                                     .Number(1003, 32)
                                                     .Text(1022, "x86_64")
                                                     .GetBytes()));
}

TEST(RpmHeaderTest, EveryCutHeaderIsRefused)
{
    const std::string whole = TRpmHeaderBuilder().Text(1000, "bash").Text(1001, "5").Text(1002, "1").GetBytes();
    for (std::size_t length = 0; length < whole.size(); ++length) {
        EXPECT_EQ("found " + std::to_string(length) + " bytes, expected a package's header", RpmText(whole.substr(0, length)));
    }
}

TEST(RpmHeaderTest, ValuesOutsideOfTheDataAreRefused)
{
    const char incomplete[] = "found a header without name, version or release, expected all three";
    EXPECT_EQ(incomplete, RpmText(TRpmHeaderBuilder().Text(1001, "5").Text(1002, "1").GetBytes()));
    EXPECT_EQ(incomplete, RpmText(TRpmHeaderBuilder().Text(1000, "").Text(1001, "5").Text(1002, "1").GetBytes()));
    EXPECT_EQ(incomplete, RpmText(TRpmHeaderBuilder().Tag(1000, 6, 4000).Text(1001, "5").Text(1002, "1").GetBytes()));
    EXPECT_EQ(incomplete, RpmText(TRpmHeaderBuilder().Tag(1000, 4, 0).Text(1001, "5").Text(1002, "1").GetBytes()));
    EXPECT_EQ("a 5-1 (none)  ",
              RpmText(TRpmHeaderBuilder().Text(1000, "a").Text(1001, "5").Text(1002, "1").Tag(1003, 4, 4000).GetBytes()));
}

TEST(RpmHeaderTest, SourcePackageIsTheNameOfItsFileWithoutVersionAndRelease)
{
    EXPECT_EQ("python3-dnf", SourcePackageOf("python3-dnf-4.14.0-9.el9.src.rpm"));
    EXPECT_EQ("", SourcePackageOf("bash"));
    EXPECT_EQ("", SourcePackageOf("bash-1"));
    EXPECT_EQ("", SourcePackageOf("-1"));
    EXPECT_EQ("", SourcePackageOf(""));
}

}  // namespace NORVZEL20
