// External entities and DTDs are never opened: the kernel reports every access to the file.
#include <sys/inotify.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>

#include "tests/hostile/HostileRow.h"

namespace NORVZEL20 {

namespace {

/// A file for which the kernel reports every opening and reading.
class ExternalEntityTest : public testing::Test {
  protected:
    void SetUp() override
    {
        char folder[] = "/tmp/cimdelta-external-XXXXXX";
        ASSERT_NE(nullptr, mkdtemp(folder));
        fFolder = folder;
        std::ofstream(fFolder / "secret.txt") << "Id";
        fNotify = inotify_init1(IN_NONBLOCK);
        ASSERT_GE(fNotify, 0);
        ASSERT_GE(inotify_add_watch(fNotify, fFolder.c_str(), IN_OPEN | IN_ACCESS), 0);
        std::filesystem::current_path(fFolder);
        WasTouched();
    }

    void TearDown() override
    {
        std::filesystem::current_path("/");
        close(fNotify);
        std::filesystem::remove_all(fFolder);
    }

    /// Whether the file was opened or read since the last call.
    bool WasTouched()
    {
        char events[4096];
        bool touched = false;
        while (read(fNotify, events, sizeof events) > 0) {
            touched = true;
        }
        return touched;
    }

    std::string Uri() const { return "file://" + (fFolder / "secret.txt").string(); }

    void ExpectUntouched(const std::vector<THostileRow>& rows)
    {
        for (const THostileRow& row : rows) {
            ExpectOutcomes({row});
            EXPECT_FALSE(WasTouched()) << row.name;
        }
    }

    std::filesystem::path fFolder;
    int fNotify = -1;
};

}  // namespace

TEST_F(ExternalEntityTest, TheWatchNoticesAReader)
{
    std::string word;
    std::ifstream(fFolder / "secret.txt") >> word;
    EXPECT_EQ("Id", word);
    EXPECT_TRUE(WasTouched());
}

TEST_F(ExternalEntityTest, ReferencesAreRefusedUnread)
{
    const std::string reason = "external entities are not read";
    ExpectUntouched({
        Refused("by address", {"<!DOCTYPE r [<!ENTITY e SYSTEM \"" + Uri() + "\">]>", "&e;"}, 0, reason),
        Refused("by path", {"<!DOCTYPE r [<!ENTITY e SYSTEM \"" + (fFolder / "secret.txt").string() + "\">]>", "&e;"}, 0, reason),
        Refused("by name", {"<!DOCTYPE r [<!ENTITY e SYSTEM \"secret.txt\">]>", "&e;"}, 0, reason),
        Refused("by public identifier", {"<!DOCTYPE r [<!ENTITY e PUBLIC \"p\" \"secret.txt\">]>", "&e;"}, 0, reason),
        Refused("through another entity", {"<!DOCTYPE r [<!ENTITY e SYSTEM \"secret.txt\"><!ENTITY f \"&e;\">]>", "&f;"}, 0,
                reason),
    });
}

TEST_F(ExternalEntityTest, ForeignDeclarationsAreLeftUnread)
{
    const auto handled = [](const std::string& name, const std::string& prolog) { return Handled(name, {prolog, "Id"}); };
    ExpectUntouched({
        handled("a DTD by address", "<!DOCTYPE r SYSTEM \"" + Uri() + "\">"),
        handled("a DTD by name", "<!DOCTYPE r SYSTEM \"secret.txt\">"),
        handled("a public DTD", "<!DOCTYPE r PUBLIC \"p\" \"secret.txt\">"),
        handled("a parameter entity", "<!DOCTYPE r [<!ENTITY % p SYSTEM \"secret.txt\">%p;]>"),
        handled("an entity declared and not used", "<!DOCTYPE r [<!ENTITY e SYSTEM \"secret.txt\">]>"),
        handled("a notation and an unparsed entity",
                "<!DOCTYPE r [<!NOTATION n SYSTEM \"secret.txt\"><!ENTITY e SYSTEM \"secret.txt\" NDATA n>]>"),
        handled("a style sheet", "<?xml-stylesheet href=\"secret.txt\"?>"),
    });
    ExpectUntouched({Refused("an entity that only the DTD could declare", {"<!DOCTYPE r SYSTEM \"secret.txt\">", "&e;"}, 0,
                             "undeclared entity")});
}

}  // namespace NORVZEL20
