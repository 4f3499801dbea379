#include <gtest/gtest.h>
#include <sqlite3.h>

#include <fstream>
#include <iterator>

#include "client/collect/read/ReadRpmHeader.h"
#include "tests/client/collect/TCollectFixture.h"
#include "tests/client/collect/TRpmHeaderBuilder.h"

namespace NORVZEL20 {

/// A system of rpm.
class RpmDatabaseTest : public TCollectFixture {
  protected:
    RpmDatabaseTest()
    {
        fSystem->Unlink("/var/lib/dpkg/status");
        fSystem->File(kDatabase, "");
    }

    void Execute(const std::string& statement, const std::string& blob = std::string())
    {
        sqlite3* database = nullptr;
        ASSERT_EQ(SQLITE_OK, sqlite3_open(fSystem->Place(kDatabase).c_str(), &database));
        sqlite3_stmt* prepared = nullptr;
        ASSERT_EQ(SQLITE_OK, sqlite3_prepare_v2(database, statement.c_str(), -1, &prepared, nullptr)) << sqlite3_errmsg(database);
        if (!blob.empty()) {
            ASSERT_EQ(SQLITE_OK, sqlite3_bind_blob(prepared, 1, blob.data(), static_cast<int>(blob.size()), SQLITE_TRANSIENT));
        }
        const int result = sqlite3_step(prepared);
        ASSERT_TRUE(result == SQLITE_DONE || result == SQLITE_ROW) << sqlite3_errmsg(database);
        sqlite3_finalize(prepared);
        ASSERT_EQ(SQLITE_OK, sqlite3_close(database));
    }

    void MakeTable() { Execute("CREATE TABLE Packages (hnum INTEGER PRIMARY KEY AUTOINCREMENT, blob BLOB NOT NULL)"); }
    void Install(const std::string& header) { Execute("INSERT INTO Packages (blob) VALUES (?)", header); }

    static std::string Header(const std::string& name, const std::string& version, const std::string& release)
    {
        return TRpmHeaderBuilder()
            .Text(1000, name)
            .Text(1001, version)
            .Text(1002, release)
            .Text(1022, "x86_64")
            .Text(1044, name + "-1-1.src.rpm")
            .GetBytes();
    }

    /// What is left out of packages.
    std::string PackagesLine()
    {
        fSystem->CollectTo("x.xml");
        const std::string lines = fSystem->GetLines();
        const std::size_t at = lines.find("not collected: packages: ");
        return at == std::string::npos ? "nothing" : lines.substr(at + 25, lines.find('\n', at) - at - 25);
    }

    static constexpr char kDatabase[] = "/var/lib/rpm/rpmdb.sqlite";
};

// A header that rpm itself wrote.
TEST_F(RpmDatabaseTest, PackagesComeFromTheDatabase)
{
    std::ifstream file(CIMDELTA_COLLECT_DATA "/hello.rpmheader", std::ios::binary);
    MakeTable();
    Install(std::string(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()));
    EXPECT_EQ("KALMO_Package.Architecture=\"noarch\",Manager=\"rpm\",Name=\"hello\"\n"
              "    Name: hello\n"
              "    Version: 7:1.0-3.el9\n"
              "    Architecture: noarch\n"
              "    Manager: rpm\n"
              "    OtherVersions: NULL\n"
              "    State: NULL\n"
              "    Selection: NULL\n"
              "    Source: NULL\n"
              "    Vendor: Made Here\n",
              Show("KALMO_Package"));
    EXPECT_EQ("nothing", PackagesLine());
}

TEST_F(RpmDatabaseTest, SeveralVersionsAreOnePackage)
{
    MakeTable();
    Install(Header("kernel", "5.14", "1"));
    Install(Header("kernel", "5.14", "2"));
    Install(Header("kernel", "5.14", "3"));
    const std::string text = Show("KALMO_Package");
    EXPECT_NE(std::string::npos, text.find("    Version: 5.14-3\n")) << text;
    EXPECT_NE(std::string::npos, text.find("    OtherVersions: {\"5.14-2\", \"5.14-1\"}\n")) << text;
}

TEST_F(RpmDatabaseTest, UpgradeIsFoundAlone)
{
    MakeTable();
    Install(Header("glibc", "2.34", "1"));
    Install(Header("bash", "5.1", "1"));
    EXPECT_EQ("KALMO_Package  ~ bash.Version: 5.1-1 -> 5.2-1\n", FoundAfter([this](TMadeSystem&) {
                  Execute("DELETE FROM Packages WHERE hnum = 2");
                  Install(Header("bash", "5.2", "1"));
              }));
}

TEST_F(RpmDatabaseTest, NothingIsWritten)
{
    MakeTable();
    Execute("PRAGMA journal_mode=WAL");
    Install(Header("bash", "5.1", "1"));
    EXPECT_NE(std::string::npos, Show("KALMO_Package").find("bash"));
    EXPECT_TRUE(TSystemRoot(fSystem->Place("")).List("/var/lib/rpm").size() == 1);
}

TEST_F(RpmDatabaseTest, ChangesThatStandInALogAreSeen)
{
    MakeTable();
    Execute("PRAGMA journal_mode=WAL");
    sqlite3* database = nullptr;
    ASSERT_EQ(SQLITE_OK, sqlite3_open(fSystem->Place(kDatabase).c_str(), &database));
    ASSERT_EQ(SQLITE_OK, sqlite3_exec(database, "SELECT hnum FROM Packages", nullptr, nullptr, nullptr));
    Install(Header("bash", "5.1", "1"));  // the open connection keeps the log
    ASSERT_LT(0U, std::filesystem::file_size(fSystem->Place(kDatabase) + "-wal"));
    EXPECT_NE(std::string::npos, Show("KALMO_Package").find("Version: 5.1-1"));
    EXPECT_EQ(SQLITE_OK, sqlite3_exec(database, "BEGIN IMMEDIATE; DELETE FROM Packages", nullptr, nullptr, nullptr));
    EXPECT_NE(std::string::npos, Show("KALMO_Package").find("Version: 5.1-1"));
    EXPECT_EQ("nothing", PackagesLine());
    sqlite3_close(database);
}

TEST_F(RpmDatabaseTest, DamagedDatabasesAreOneLine)
{
    fSystem->File(kDatabase, "no database");
    EXPECT_EQ("/var/lib/rpm/rpmdb.sqlite: the database cannot be read: file is not a database", PackagesLine());
    fSystem->File(kDatabase, "");
    EXPECT_EQ("/var/lib/rpm/rpmdb.sqlite: the database cannot be read: no such table: Packages", PackagesLine());
    MakeTable();
    Install("rubbish");
    EXPECT_EQ("/var/lib/rpm/rpmdb.sqlite: found 7 bytes, expected a package's header", PackagesLine());
}

TEST_F(RpmDatabaseTest, OtherFormsAreNamed)
{
    fSystem->Unlink(kDatabase);
    fSystem->File("/var/lib/rpm/Packages.db", "RpmP");
    const std::string advice = " (rpm 4.16 or later turns it into one with rpmdb --rebuilddb --define '_db_backend sqlite')";
    EXPECT_EQ("/var/lib/rpm/Packages.db: found a database of rpm in the form of ndb, expected SQLite" + advice, PackagesLine());
    fSystem->Unlink("/var/lib/rpm/Packages.db");
    fSystem->File("/var/lib/rpm/Packages", "");
    EXPECT_EQ("/var/lib/rpm/Packages: found a database of rpm in the form of Berkeley DB, expected SQLite" + advice,
              PackagesLine());
}

}  // namespace NORVZEL20
