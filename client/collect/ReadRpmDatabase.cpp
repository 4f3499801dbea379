// rpm's database: a file of SQLite, whose table Packages has a header (see ReadRpmHeader.cpp) for each package.
//
// Readers of SQLite usually take a lock and may make files beside the database. Neither is right for a look from outside, so an
// unchanged database is opened as immutable. A log of changes (-wal) beside it means that a program is changing it, or was
// interrupted; then the database is opened in the usual way, for reading only, which sees the state of the last complete change.
#include "client/collect/ReadRpmDatabase.h"

#include <sqlite3.h>

#include <memory>
#include <utility>

#include "client/collect/read/ReadRpmHeader.h"

namespace NORVZEL20 {

namespace {

constexpr int kMostHeaderBytes = 64 << 20;

struct TCloseDatabase {
    void operator()(sqlite3* database) const { sqlite3_close(database); }
};
struct TEndStatement {
    void operator()(sqlite3_stmt* statement) const { sqlite3_finalize(statement); }
};
using TDatabase = std::unique_ptr<sqlite3, TCloseDatabase>;
using TStatement = std::unique_ptr<sqlite3_stmt, TEndStatement>;

bool HasLog(const TSystemRoot& root, const std::string& path)
{
    const std::optional<struct stat> log = root.Look(path + "-wal");
    return log && log->st_size > 0;
}

TDatabase OpenDatabase(const TSystemRoot& root, const std::string& path, int descriptor)
{
    // The descriptor's name leads SQLite to the file that was checked.
    const std::string address =
        "file:/proc/self/fd/" + std::to_string(descriptor) + (HasLog(root, path) ? "?mode=ro" : "?immutable=1");
    sqlite3* database = nullptr;
    sqlite3_open_v2(address.c_str(), &database, SQLITE_OPEN_READONLY | SQLITE_OPEN_URI | SQLITE_OPEN_NOMUTEX, nullptr);
    TDatabase owner(database);
    if (database != nullptr) {
        sqlite3_limit(database, SQLITE_LIMIT_LENGTH, kMostHeaderBytes);
    }
    return owner;
}

void ReadHeaders(TCollection& collection, const std::string& path, sqlite3* database, std::vector<TRpmPackage>& packages)
{
    sqlite3_stmt* prepared = nullptr;
    int result = sqlite3_prepare_v2(database, "SELECT blob FROM Packages ORDER BY hnum", -1, &prepared, nullptr);
    const TStatement statement(prepared);
    std::string trouble;
    while (result == SQLITE_OK && (result = sqlite3_step(prepared)) == SQLITE_ROW) {
        result = SQLITE_OK;
        collection.CheckTime();
        const auto* const bytes = static_cast<const char*>(sqlite3_column_blob(prepared, 0));
        const auto length = static_cast<std::size_t>(sqlite3_column_bytes(prepared, 0));
        TRpmPackage package;
        if (ReadRpmHeader(std::string_view(bytes, bytes == nullptr ? 0 : length), package, trouble)) {
            packages.push_back(package);
        } else {
            collection.LeaveOut(path, trouble);
        }
    }
    if (result != SQLITE_DONE) {
        collection.LeaveOut(path, "the database cannot be read: " + std::string(sqlite3_errmsg(database)));
    }
}

void NoteOtherForms(TCollection& collection, const std::string& folder)
{
    for (const auto& [name, form] : {std::pair("Packages", "Berkeley DB"), std::pair("Packages.db", "ndb")}) {
        if (collection.GetRoot().Look(folder + name)) {
            collection.LeaveOut(folder + name, "found a database of rpm in the form of " + std::string(form) + ", expected SQLite",
                                "rpm 4.16 or later turns it into one with rpmdb --rebuilddb --define '_db_backend sqlite'");
        }
    }
}

}  // namespace

std::vector<TRpmPackage> ReadRpmDatabase(TCollection& collection)
{
    std::vector<TRpmPackage> packages;
    const TSystemRoot& root = collection.GetRoot();
    for (const std::string folder : {"/usr/lib/sysimage/rpm/", "/var/lib/rpm/"}) {
        if (root.ReadLink(folder.substr(0, folder.size() - 1))) {
            continue;  // the other one
        }
        const std::string path = folder + "rpmdb.sqlite";
        if (!root.Look(path)) {
            NoteOtherForms(collection, folder);
            continue;
        }
        std::string trouble;
        const TDescriptor file = root.OpenFile(path, trouble);
        if (!file) {
            collection.LeaveOut(path, trouble);
            continue;
        }
        const TDatabase database = OpenDatabase(root, path, file.Get());
        ReadHeaders(collection, path, database.get(), packages);
    }
    return packages;
}

}  // namespace NORVZEL20
