#include <gtest/gtest.h>

#include <map>
#include <nlohmann/json.hpp>
#include <random>
#include <set>

#include "tests/client/Documents.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

const char kNull[] = "NULL";

/// Made inventories of one class, as plain data: for each inventory and key its instances, each with its values.
class TMadeFleet {
  public:
    using TValues = std::map<std::string, std::string>;
    using TInstances = std::map<std::string, std::vector<TValues>>;

    /// Of each key, an inventory has up to `mostSharing` instances.
    TMadeFleet(unsigned seed, std::size_t mostSharing) : fRandom(seed), fInventories(3 + Pick(4))
    {
        for (TInstances& instances : fInventories) {
            for (const char* const key : {"k1", "k2", "k3", "k4"}) {
                const std::size_t count = Pick(10) < 7 ? 1 + Pick(mostSharing) : 0;
                for (std::size_t i = 0; i < count; ++i) {
                    instances[key].push_back({{"A", PickValue()}, {"B", PickValue()}});
                }
            }
        }
    }

    std::size_t Count() const { return fInventories.size(); }

    std::string Text(std::size_t inventory) const
    {
        std::string text =
            System() +
            Class("Thing", "", KeyProperty("Key") + KeyProperty("Id") + Declaration("A", "string") + Declaration("B", "string"));
        int id = 0;
        for (const auto& [key, instances] : fInventories[inventory]) {
            for (const TValues& values : instances) {
                std::string properties = NORVZEL20::Value("Key", key) + NORVZEL20::Value("Id", std::to_string(id++));
                for (const auto& [name, value] : values) {
                    properties += value == kNull ? std::string() : NORVZEL20::Value(name, value);
                }
                text += Instance("Thing", properties);
            }
        }
        return Document(text);
    }

    /// What a comparison with the majority must find, one line a difference, worked out from the data alone.
    std::set<std::string> Expected() const
    {
        std::set<std::string> lines;
        for (const char* const key : {"k1", "k2", "k3", "k4"}) {
            ExpectOf(key, lines);
        }
        return lines;
    }

  private:
    std::size_t Pick(std::size_t count) { return std::uniform_int_distribution<std::size_t>(0, count - 1)(fRandom); }

    std::string PickValue()
    {
        const char* const values[] = {"1", "1", "2", "3", kNull};
        return values[Pick(5)];
    }

    // Those that count: of the first inventory, only the first.
    std::vector<TValues> Of(std::size_t inventory, const std::string& key) const
    {
        const auto found = fInventories[inventory].find(key);
        std::vector<TValues> all = found == fInventories[inventory].end() ? std::vector<TValues>() : found->second;
        if (inventory == 0 && all.size() > 1) {
            all.resize(1);
        }
        return all;
    }

    void ExpectOf(const std::string& key, std::set<std::string>& lines) const
    {
        std::string have;
        std::string lack;
        std::size_t having = 0;
        for (std::size_t i = 0; i < Count(); ++i) {
            const bool has = !Of(i, key).empty();
            having += has ? 1 : 0;
            (has ? have : lack) += " i" + std::to_string(i);
        }
        const std::size_t lacking = Count() - having;
        if (having < lacking || (having == lacking && Of(0, key).empty())) {
            if (having > 0) {
                lines.insert(key + " only in" + have);
            }
            return;
        }
        if (lacking > 0) {
            lines.insert(key + " not in" + lack);
        }
        ExpectChange(key, "A", lines);
        ExpectChange(key, "B", lines);
    }

    void ExpectChange(const std::string& key, const std::string& property, std::set<std::string>& lines) const
    {
        std::map<std::string, std::vector<std::size_t>> votes;
        std::map<std::string, std::string> holders;
        for (std::size_t i = 0; i < Count(); ++i) {
            std::map<std::string, std::size_t> counts;
            for (const TValues& values : Of(i, key)) {
                ++counts[values.at(property)];
            }
            for (const auto& [value, count] : counts) {
                holders[value] += " i" + std::to_string(i) + "x" + std::to_string(count);
            }
            if (counts.size() == 1) {
                votes[counts.begin()->first].push_back(i);
            }
        }
        if (holders.size() < 2) {
            return;
        }
        const std::string winner = votes.empty() ? FirstValue(key, property) : Winner(votes);
        holders.erase(winner);
        std::string line = key + "." + property + ": " + winner;
        for (const auto& [value, who] : holders) {
            line += "; " + value + who;
        }
        lines.insert(line);
    }

    std::string FirstValue(const std::string& key, const std::string& property) const
    {
        std::size_t inventory = 0;
        while (Of(inventory, key).empty()) {
            ++inventory;
        }
        return Of(inventory, key).front().at(property);
    }

    static std::string Winner(const std::map<std::string, std::vector<std::size_t>>& votes)
    {
        std::string winner;
        std::vector<std::size_t> best;
        for (const auto& [value, voters] : votes) {
            if (voters.size() > best.size() || (voters.size() == best.size() && voters < best)) {
                winner = value;
                best = voters;
            }
        }
        return winner;
    }

    std::mt19937 fRandom;
    std::vector<TInstances> fInventories;
};

using TJson = nlohmann::json;

/// Compares with the majority and reads the JSON.
class MajorityTest : public TClientFixture {
  protected:
    std::vector<std::string> Files(const TMadeFleet& fleet)
    {
        std::vector<std::string> files;
        for (std::size_t i = 0; i < fleet.Count(); ++i) {
            const std::string name = "i" + std::to_string(i);
            files.push_back(name + "=" + Scratch(name + ".xml", fleet.Text(i)));
        }
        return files;
    }

    TJson Compare(const std::vector<std::string>& files, const std::vector<std::string>& options = {})
    {
        std::vector<std::string> arguments{"compare", "--reference", "majority", "-o", "json"};
        arguments.insert(arguments.end(), files.begin(), files.end());
        arguments.insert(arguments.end(), options.begin(), options.end());
        return TJson::parse(Result(arguments));
    }

    static std::string TextOf(const TJson& value) { return value.is_null() ? kNull : value.get<std::string>(); }

    static std::string Who(const TJson& inventories)
    {
        std::string who;
        for (const TJson& label : inventories) {
            who += " " + label.get<std::string>();
        }
        return who;
    }

    static std::string WhoHas(const TJson& group)
    {
        std::map<std::string, std::size_t> counts;
        for (const TJson& label : group["inventories"]) {
            counts[label] = 1;
        }
        for (const TJson& sharing : group.value("sharing", TJson::array())) {
            counts[sharing["inventory"]] = sharing["instances"];
        }
        std::string who;
        for (const auto& [label, count] : counts) {
            who += " " + label + "x" + std::to_string(count);
        }
        return who;
    }

    static std::set<std::string> LinesOf(const TJson& report)
    {
        std::set<std::string> lines;
        for (const TJson& difference : report["differences"]) {
            const std::string key = difference["keys"]["Key"];
            if (difference["kind"] != "changed") {
                lines.insert(key + (difference["kind"] == "onlyInOthers" ? " only in" : " not in") +
                             Who(difference["inventories"]));
                continue;
            }
            std::map<std::string, std::string> values;
            for (const TJson& group : difference["others"]) {
                values[TextOf(group["value"])] += WhoHas(group);
            }
            std::string line =
                key + "." + difference["property"].get<std::string>() + ": " + TextOf(difference["reference"]["value"]);
            for (const auto& [value, who] : values) {
                line += "; " + value + who;
            }
            lines.insert(line);
        }
        EXPECT_EQ(report["summary"]["differences"], lines.size());
        return lines;
    }
};

/// Fleets in which `mostSharing` instances of an inventory may have one key.
class FleetMajorityTest : public MajorityTest, public ::testing::WithParamInterface<std::size_t> {};

TEST_P(FleetMajorityTest, IsWhatMostInventoriesHave)
{
    const std::string rules = Scratch("ids.xml", "<DifftoolSpec><class name='Thing' default='include' excludekeys='Id'>"
                                                 "<excludelist><value>Id</value></excludelist></class></DifftoolSpec>");
    std::size_t found = 0;
    for (unsigned seed = 1; seed <= 60; ++seed) {
        const TMadeFleet fleet(seed, GetParam());
        const std::set<std::string> expected = fleet.Expected();
        found += expected.size();
        EXPECT_EQ(expected, LinesOf(Compare(Files(fleet), {"--spec", rules}))) << "seed " << seed;
    }
    EXPECT_LT(200U, found);
}

INSTANTIATE_TEST_SUITE_P(InstancesWithOneKey, FleetMajorityTest, ::testing::Values(1, 3));

/// One package in each of several systems, told apart by version and vendor.
class ReferenceTest : public MajorityTest {
  protected:
    void System(const std::string& name, const std::string& packages)
    {
        const std::string schema =
            Class("Package", "", KeyProperty("Name") + Declaration("Version", "string") + Declaration("Vendor", "string"));
        fFiles.push_back(name + "=" + Scratch(name + ".xml", Document(NORVZEL20::System() + schema + packages)));
    }

    static std::string Package(const std::string& name, const std::string& version, const std::string& vendor = std::string())
    {
        return Instance("Package", NORVZEL20::Value("Name", name) + NORVZEL20::Value("Version", version) +
                                       (vendor.empty() ? "" : NORVZEL20::Value("Vendor", vendor)));
    }

    std::vector<std::string> Arguments(const std::vector<std::string>& options) const
    {
        std::vector<std::string> arguments{"compare"};
        arguments.insert(arguments.end(), fFiles.begin(), fFiles.end());
        arguments.insert(arguments.end(), options.begin(), options.end());
        return arguments;
    }

    /// The report above its coverage.
    std::string Report(const std::vector<std::string>& options)
    {
        const std::string report = Result(Arguments(options));
        return report.substr(0, report.rfind("\n\n") + 1);
    }

    std::vector<std::string> fFiles;
};

TEST_F(ReferenceTest, AnyInventoryMayBeTheReference)
{
    System("web01", Package("bash", "1"));
    System("web02", Package("bash", "1"));
    System("web03", Package("bash", "2"));
    EXPECT_EQ("web03 against 2 others: 1 difference; both differ\n"
              "    1  web01, web02\n"
              "\n"
              "Package  ~1   bash.Version: 2 -> 1 (web01, web02)\n",
              Report({"--reference", "web03"}));
    EXPECT_EQ(Report({"--reference", "web03"}), Report({"--reference", fFiles.back()}));
}

TEST_F(ReferenceTest, AMissingInstanceIsShownAsMostHaveIt)
{
    System("web01", Package("bash", "1"));
    System("web02", "");
    System("web03", Package("bash", "2", "Debian"));
    System("web04", Package("bash", "2", "Debian"));
    EXPECT_EQ("majority", Compare(fFiles)["inventories"][0]["label"]);
    EXPECT_NE(std::string::npos,
              Result(Arguments({"--reference", "majority", "--detail"})).find("- Name=\"bash\"  (not in web02)"));
}

TEST_F(ReferenceTest, CoverageIsThatOfTheInventories)
{
    System("web01", Package("bash", "1"));
    System("web02", Package("bash", "1"));
    System("web03", Package("bash", "2"));
    const std::string report = Result(Arguments({"--reference", "majority", "--coverage"}));
    EXPECT_NE(std::string::npos,
              report.find("Compared: 2 classes; 2 instances of web01, 2 instances of web02, 2 instances of web03."));
    const TJson first = Compare(fFiles)["inventories"][0];
    EXPECT_EQ("reference", first["role"]);
    EXPECT_EQ("", first["file"]);
    EXPECT_EQ(0, first["instancesCompared"]);
}

TEST_F(ReferenceTest, WhatCannotBeAReferenceIsRefused)
{
    System("web01", "");
    System("web02", "");
    const std::string two = "cimdelta: two inventories have no majority; name three or more, or leave out --reference majority and "
                            "--outliers\n";
    EXPECT_EQ(two, Complaint(Arguments({"--reference", "majority"})));
    EXPECT_EQ(two, Complaint(Arguments({"--outliers"})));
    EXPECT_EQ("cimdelta: no inventory is called web20; did you mean web02? For --reference give one of these labels, or majority: "
              "web01, web02\n",
              Complaint(Arguments({"--reference", "web20"})));
    System("web03", "");
    EXPECT_EQ(
        "cimdelta: the records of -o cimxml name the differences from an inventory, not from the majority; use another format, "
        "or name an inventory with --reference\n",
        Complaint(Arguments({"--reference", "majority", "-o", "cimxml"})));
    System("majority", "");
    EXPECT_EQ(
        "cimdelta: an inventory is called majority, the name that reports give to what most inventories hold; give it another "
        "label: LABEL=SOURCE\n",
        Complaint(Arguments({"--reference", "majority"})));
}

TEST_F(ReferenceTest, AMadeSystemDoesNotVote)
{
    const std::string schema = Class("Package", "", KeyProperty("Name"));
    const auto host = [&](const std::string& name, const std::string& type) {
        const std::string system =
            Class("KALMO_OperatingSystem", "", KeyProperty("Name") + Declaration("OSType", "uint16")) +
            (type.empty() ? ""
                          : Instance("KALMO_OperatingSystem",
                                     NORVZEL20::Value("Name", "host") + NORVZEL20::Value("OSType", type, "uint16")));
        fFiles.push_back(name + "=" + Scratch(name + ".xml", Document(system + schema)));
    };
    host("a", "36");
    host("b", "");
    host("c", "");
    host("d", "18");
    host("e", "18");
    const TJson differences = Compare(fFiles)["differences"];
    ASSERT_EQ(1U, differences.size());
    EXPECT_EQ(18, differences[0]["reference"]["value"]);
    EXPECT_EQ(TJson({"a"}), differences[0]["inventories"]);
}

}  // namespace
}  // namespace NORVZEL20
