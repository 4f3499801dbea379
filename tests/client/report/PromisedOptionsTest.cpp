// What a report leaves out of a group it counts, with the option that shows it: "... 42 more (--property Version)". These tests run
// each option that a report names, beside those with which the report was made, and look for all members.
#include <map>
#include <nlohmann/json.hpp>
#include <regex>
#include <set>
#include <sstream>

#include "client/findings/CollectFindings.h"
#include "tests/client/report/TGroupedFixture.h"

namespace NORVZEL20 {
namespace {

class PromisedOptionsTest : public TGroupedFixture {
  protected:
    using TOptions = std::vector<std::string>;

    /// Six systems with groups of all sizes.
    void Fleet()
    {
        for (const char* const name : {"a", "b", "c", "d", "e", "f"}) {
            std::string contents =
                PlainClass("Package", {"Version", "Build", "Vendor"}) + PlainClass("Service", {"Version", "State"});
            for (int i = 0; i < 250; ++i) {
                contents += Package(*name, i);
            }
            for (int i = 0; i < 12; ++i) {
                contents += Instance("Service", Value("Name", Numbered("ser", i)) +
                                                    Value("Version", *name == 'd' ? Numbered("vd", i) : "same") +
                                                    Value("State", *name >= 'e' && i > 2 ? "down" : "up"));
            }
            System(name, contents);
        }
    }

    static std::string Package(char system, int number)
    {
        if (system == 'f' && number < 11) {
            return std::string();
        }
        return Instance("Package", Value("Name", Numbered(system == 'e' && number > 240 ? "odd" : "pkg", number)) +
                                       Value("Version", Numbered(system == 'b' && number < 20 ? "new" : "old", number)) +
                                       Value("Build", Numbered(system == 'c' && number < 230 ? "later" : "built", number)) +
                                       Value("Vendor", system == 'd' && number > 200 ? "Other" : "Usual"));
    }

    static std::string Numbered(const std::string& name, int number) { return name + std::to_string(1000 + number); }

    /// The options that the report names beside what it leaves out.
    static std::set<std::string> PromisesOf(const std::string& report)
    {
        std::set<std::string> promises;
        const std::regex promise("\\((--detail|--property \\S+)\\)");
        for (std::sregex_iterator found(report.begin(), report.end(), promise); found != std::sregex_iterator(); ++found) {
            promises.insert((*found)[1]);
        }
        return promises;
    }

    /// The names of the instances that differ, and their new values. If a property is given, only of those in which that differs,
    /// and not of groups that are too large to be shown whole.
    std::set<std::string> MembersOf(TOptions options, const std::string& property)
    {
        options.insert(options.end(), {"-o", "ndjson"});
        std::istringstream lines(Compare(options));
        std::map<std::string, std::vector<nlohmann::json>> groups;
        for (std::string line; std::getline(lines, line);) {
            const nlohmann::json difference = nlohmann::json::parse(line);
            if (difference.contains("instance") && (property.empty() || difference.value("property", "") == property)) {
                groups[difference["class"].dump() + difference["inventories"].dump()].push_back(difference);
            }
        }
        std::set<std::string> members;
        for (const auto& [where, differences] : groups) {
            for (const nlohmann::json& difference : differences) {
                if (property.empty() || differences.size() <= kMostExamples) {
                    AddMembers(difference, members);
                }
            }
        }
        return members;
    }

    static void AddMembers(const nlohmann::json& difference, std::set<std::string>& members)
    {
        members.insert(difference["keys"]["Name"]);
        for (const nlohmann::json& group : difference.value("others", nlohmann::json::array())) {
            members.insert(group["value"].get<std::string>());
        }
    }

    /// Returns what is not in the report that a promised option makes.
    std::set<std::string> Missing(const TOptions& options, const std::string& promise)
    {
        const std::size_t blank = promise.find(' ');
        const std::string property = blank == std::string::npos ? std::string() : promise.substr(blank + 1);
        TOptions promised = options;
        promised.push_back(promise.substr(0, blank));
        if (!property.empty()) {
            promised.push_back(property);
        }
        const std::string report = Compare(promised);
        std::set<std::string> missing = MembersOf(options, property);
        EXPECT_FALSE(missing.empty()) << promise;
        for (auto member = missing.begin(); member != missing.end();) {
            member = report.find(*member) == std::string::npos ? std::next(member) : missing.erase(member);
        }
        return missing;
    }

    void ExpectPromisesAreKept(const std::vector<TOptions>& rows)
    {
        std::size_t count = 0;
        for (const TOptions& options : rows) {
            const std::set<std::string> promises = PromisesOf(Compare(options));
            count += promises.size();
            for (const std::string& promise : promises) {
                EXPECT_EQ(std::set<std::string>(), Missing(options, promise)) << ::testing::PrintToString(options) << promise;
            }
        }
        EXPECT_LT(rows.size(), count);  // some reports make several
    }
};

TEST_F(PromisedOptionsTest, ShowAllMembersOfTheirGroups)
{
    Fleet();
    Compare({"--accept", "kept.txt", "--class", "Service"});
    fFiles.push_back("kept.txt");
    ExpectPromisesAreKept({{},
                           {"--full"},
                           {"--outliers"},
                           {"--limit", "12"},
                           {"--limit", "400"},
                           {"--outliers", "--limit", "12"},
                           {"--outliers", "--limit", "400"},
                           {"--reference", "majority"},
                           {"--reference", "c"},
                           {"--only", "~"},
                           {"--only", "+,-"},
                           {"--only", "~", "--outliers"},
                           {"--class", "Package"},
                           {"--class", "Service", "--outliers"},
                           {"--property", "Build"},
                           {"--property", "*"},
                           {"--property", "Version", "--limit", "12"},
                           {"--property", "Version", "--outliers"},
                           {"--baseline", "kept.txt"},
                           {"--baseline", "kept.txt", "--outliers"}});
}

TEST_F(PromisedOptionsTest, DoSoOnATerminalToo)
{
    Fleet();
    fTerminal = true;
    ExpectPromisesAreKept({{}, {"--outliers"}, {"--outliers", "--limit", "12"}, {"--only", "~"}});
}

}  // namespace
}  // namespace NORVZEL20
