// The commands that read a rules file agree on whether it can be used, and why not.
#include <filesystem>

#include "fuzz/SampleInventory.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

const std::filesystem::path kCorpus = std::filesystem::path(CIMDELTA_FUZZ_FOLDER) / "corpus" / "specification";

class RulesVerdictTest : public TClientFixture {
  protected:
    /// "accepted", or the message that refuses the rules. Remarks on the inventory come before it.
    std::string Verdict(const std::vector<std::string>& arguments)
    {
        Run(arguments);
        if (fStatus != 2) {
            return "accepted";
        }
        const std::size_t last = fErr.rfind("cimdelta: ");
        return last == std::string::npos ? "refused without a message: " + fErr : fErr.substr(last);
    }

    /// The same from `check`, `explain` and `compare`, which must agree.
    std::string CommonVerdict(const std::string& rules)
    {
        const std::string check = Verdict({"check", rules, "--schema", fInventory});
        EXPECT_EQ(check, Verdict({"explain", "Disk.Size", "--spec", rules, "--schema", fInventory}));
        EXPECT_EQ(check, Verdict({"compare", "--detail", "--allow-empty", "--spec", rules, fInventory, fAgain}));
        // Without an inventory there are fewer reasons to refuse rules, but no others.
        const std::string alone = Verdict({"check", rules});
        if (alone != "accepted") {
            EXPECT_EQ(check, alone);
        }
        return check;
    }

    const std::string fInventory = Scratch("sample.xml", GetSampleDocument());
    const std::string fAgain = Scratch("again.xml", GetSampleDocument());
};

TEST_F(RulesVerdictTest, AllCommandsAgreeOnEachFileOfTheCorpus)
{
    std::size_t accepted = 0;
    std::size_t refused = 0;
    for (const auto& entry : std::filesystem::directory_iterator(kCorpus)) {
        SCOPED_TRACE(entry.path());
        const std::string verdict = CommonVerdict(entry.path().string());
        if (verdict == "accepted") {
            ++accepted;
        } else {
            EXPECT_EQ(0u, verdict.find("cimdelta: " + entry.path().string() + ":")) << verdict;
            ++refused;
        }
    }
    EXPECT_LT(0u, accepted) << "in " << kCorpus;
    EXPECT_LT(0u, refused) << "in " << kCorpus;
}

/// The size that the system gives for a file does not matter.
TEST_F(RulesVerdictTest, AllCommandsReadAFileToItsEnd)
{
    const std::string saidToBeEmpty = "/proc/version";
    ASSERT_EQ(0u, std::filesystem::file_size(saidToBeEmpty));
    EXPECT_EQ("cimdelta: /proc/version:1: syntax error; correct the file\n", CommonVerdict(saidToBeEmpty));
}

TEST_F(RulesVerdictTest, AllCommandsAgreeOnFilesThatLackAByte)
{
    std::size_t accepted = 0;
    std::size_t number = 0;
    for (const char* name : {"nested-value.xml", "subclass-first.xml"}) {
        const std::string whole = ReadFile((kCorpus / name).string());
        ASSERT_LT(0u, whole.size()) << name;
        for (std::size_t at = 0; at < whole.size(); ++at) {
            const std::string rules = Scratch("damaged", std::string(whole).erase(at, 1));
            SCOPED_TRACE(std::string(name) + " without byte " + std::to_string(at));
            accepted += CommonVerdict(rules) == "accepted" ? 1 : 0;
            ++number;
        }
    }
    EXPECT_LT(0u, accepted);
    EXPECT_LT(accepted, number);
}

}  // namespace
}  // namespace NORVZEL20
