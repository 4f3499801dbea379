// systemd's answer over D-Bus, from a service manager that the test makes: it listens at a socket, greets as a bus does, and
// answers the call as told. A build without libsystemd has to say so instead.
#include <gtest/gtest.h>

#include "client/collect/AskServiceManager.h"

#ifdef CIMDELTA_HAS_LIBSYSTEMD
#include "tests/client/collect/TMadeServiceManager.h"
#endif

namespace NORVZEL20 {

namespace {

std::string Ask(const std::string& address)
{
    std::string trouble;
    const std::optional<std::vector<TUnitState>> states = AskServiceManager(address, trouble);
    std::string text = states ? "" : trouble;
    for (const TUnitState& state : states.value_or(std::vector<TUnitState>())) {
        text += state.name + "|" + state.description + "|" + state.activeState + "|" + state.subState + "\n";
    }
    return text;
}

}  // namespace

#ifdef CIMDELTA_HAS_LIBSYSTEMD

TEST(ServiceManagerTest, UnitsHaveTheirStates)
{
    TMadeServiceManager manager({{"ssh.service", "Shell", "loaded", "active", "running"},
                                 {"gone.service", "gone.service", "not-found", "inactive", "dead"},
                                 {"cron.service", "Jobs", "loaded", "failed", "failed"}});
    EXPECT_EQ("ssh.service|Shell|active|running\ncron.service|Jobs|failed|failed\n", Ask(manager.GetAddress()));
}

TEST(ServiceManagerTest, NoUnitsAreAnAnswerToo)
{
    TMadeServiceManager manager({});
    EXPECT_EQ("", Ask(manager.GetAddress()));
}

TEST(ServiceManagerTest, WhoDoesNotAnswerIsSaid)
{
    EXPECT_EQ("systemd does not answer: No such file or directory", Ask("unix:path=/nowhere/bus"));
    EXPECT_EQ("systemd does not answer: Connection refused", Ask("rubbish"));
}

#else

TEST(ServiceManagerTest, WithoutTheLibraryNothingIsKnown)
{
    EXPECT_EQ("this cimdelta was built without libsystemd", Ask(""));
}

#endif

}  // namespace NORVZEL20
