// What a draft writes must mean what the draft says: the plug-in's own reading of the written file is compared with the draft, for
// random rules and random changes.
#include "client/rules/TRulesDraft.h"

#include <gtest/gtest.h>

#include <random>

#include "embedded/store/TInMemNamespace.h"
#include "embedded/value/TValueXml.h"
#include "host/RootClassName.h"
#include "tests/support/TNamespaceBuilder.h"

namespace NORVZEL20 {
namespace {

// Two trees: A above B and C, B above D and E; X above Y. Properties and keys are added on the way down.
boost::shared_ptr<TInMemNamespace> MakeTrees()
{
    const boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
    const auto key = [](const char* name) { return TNamespaceBuilder::Key(name); };
    const auto property = [](const char* name) { return TNamespaceBuilder::Property(name); };
    TNamespaceBuilder(ns)
        .Class("A", "", {property("p"), property("DateTimeOfCollection")})
        .Class("B", "A", {key("k1"), key("k2"), property("q")})
        .Class("C", "A", {property("r")})
        .Class("D", "B", {property("s")})
        .Class("E", "B", {property("t")})
        .Class("X", "", {key("k1"), property("u")})
        .Class("Y", "X", {property("v")});
    return ns;
}

class RulesDraftTest : public ::testing::Test {
  protected:
    std::size_t Choose(std::size_t count) { return fRandom() % count; }

    std::string PickName(const std::vector<std::string>& names)
    {
        std::string name = names[Choose(names.size())];
        // Letter case counts in rules, so it must survive.
        if (Choose(6) == 0) {
            name.front() = static_cast<char>(TNameText::ToLower(name.front()) == name.front() ? std::toupper(name.front())
                                                                                              : std::tolower(name.front()));
        }
        return name;
    }

    /// Elements in any order, with lists of properties that the class has.
    std::string RandomRules()
    {
        std::string text = "<DifftoolSpec>";
        for (std::size_t i = Choose(7); i > 0; --i) {
            text += "<class";
            const std::size_t at = Choose(kClasses.size() + 1);
            const bool isRoot = at == kClasses.size();
            TValueXml::AppendAttribute(text, "name", isRoot ? kRootClassName : PickName({kClasses[at].first}));
            if (Choose(4) > 0) {
                TValueXml::AppendAttribute(text, "default", Choose(2) == 0 ? "include" : "exclude");
            }
            if (Choose(3) == 0) {
                TValueXml::AppendAttribute(text, "excludekeys", Choose(2) == 0 ? "k1" : "k2 other");
            }
            text += ">";
            for (std::size_t j = isRoot ? 0 : Choose(4); j > 0; --j) {
                const std::string list = Choose(2) == 0 ? "includelist" : "excludelist";
                text += "<" + list + "><value>" + PickName(kClasses[at].second) + "</value></" + list + ">";
            }
            text += "</class>";
        }
        return text + "</DifftoolSpec>";
    }

    TRulesDraft::TNames RandomProperties(const TRulesDraft::TClass& cls)
    {
        TRulesDraft::TNames names;
        for (const std::string& name : cls.declared) {
            if (Choose(2) == 0) {
                names.insert(name);
            }
        }
        return names;
    }

    void ChangeAtRandom(TRulesDraft& draft)
    {
        for (std::size_t i = Choose(5); i > 0; --i) {
            const std::size_t position = 1 + Choose(draft.GetClasses().size() - 1);
            const TRulesDraft::TClass& cls = draft.GetClasses()[position];
            switch (Choose(4)) {
            case 0:
                draft.LeaveOut(position);
                break;
            case 1:
                draft.LeaveOutProperties(position, RandomProperties(cls));
                break;
            case 2:
                draft.CompareOnly(position, RandomProperties(cls));
                break;
            default:
                draft.ExcludeKey(position, Choose(2) == 0 ? "K1" : "k2");
            }
        }
    }

    /// What each class has by the rules in `text`, as the plug-in reads them.
    std::string MeaningOf(const std::string& text)
    {
        TRules rules(fSchema, {"rules", text, false});
        std::string meaning;
        for (const auto& entry : kClasses) {
            const std::vector<std::string> compared = rules.PropertiesOf(fSchema->FindClass(entry.first));
            meaning += Line(entry.first, {compared.begin(), compared.end()}, rules.ExcludedKeysOf(entry.first));
        }
        return meaning;
    }

    static std::string MeaningOf(const TRulesDraft& draft)
    {
        std::map<std::string, std::string> lines;
        for (const TRulesDraft::TClass& cls : draft.GetClasses()) {
            lines[cls.name] = Line(cls.name, cls.compared, cls.excludedKeys);
        }
        std::string meaning;
        for (const auto& entry : kClasses) {
            meaning += lines[entry.first];
        }
        return meaning;
    }

    // The keys of a class that is not compared do not matter.
    static std::string Line(const std::string& name, const std::set<std::string>& compared, const std::vector<std::string>& keys)
    {
        std::string line = name + ":";
        for (const std::string& property : compared) {
            line += " " + property;
        }
        for (std::size_t i = 0; !compared.empty() && i < keys.size(); ++i) {
            line += " -" + keys[i];
        }
        return line + "\n";
    }

    TRulesDraft MakeDraft(const std::string& text)
    {
        TRules rules(fSchema, {"rules", text, false});
        return TRulesDraft(fSchema, rules, false);
    }

    static const std::vector<std::pair<std::string, std::vector<std::string>>> kClasses;

    const boost::shared_ptr<TInMemNamespace> fSchema = MakeTrees();
    std::mt19937 fRandom{11};
};

const std::vector<std::pair<std::string, std::vector<std::string>>> RulesDraftTest::kClasses = {
    {"A", {"p", "DateTimeOfCollection"}},
    {"B", {"p", "k1", "k2", "q"}},
    {"C", {"p", "r"}},
    {"D", {"q", "s", "k1"}},
    {"E", {"p", "q", "t"}},
    {"X", {"k1", "u"}},
    {"Y", {"u", "v"}},
};

TEST_F(RulesDraftTest, MeansWhatTheRulesMeant)
{
    for (int i = 0; i < 3000; ++i) {
        const std::string text = RandomRules();
        const std::string written = MakeDraft(text).Write({"a -- comment --"});
        ASSERT_EQ(MeaningOf(text), MeaningOf(written)) << text << "\n" << written;
    }
}

TEST_F(RulesDraftTest, WritesWhatItSaysAfterAnyChanges)
{
    std::size_t compared = 0;
    for (int i = 0; i < 3000; ++i) {
        TRulesDraft draft = MakeDraft(RandomRules());
        ChangeAtRandom(draft);
        const std::string written = draft.Write({});
        ASSERT_EQ(MeaningOf(draft), MeaningOf(written)) << written;
        // A draft of what was written is the same, down to the text.
        ASSERT_EQ(written, MakeDraft(written).Write({}));
        compared += draft.GetClasses()[4].compared.size();
    }
    EXPECT_GT(compared, 1000U);
}

const char kAll[] = "<DifftoolSpec><class name=\"&lt;root&gt;\" default=\"include\"/></DifftoolSpec>";

TEST_F(RulesDraftTest, HasOneElementForEachClassThatDiffersFromTheOneAbove)
{
    TRulesDraft draft = MakeDraft(kAll);
    draft.LeaveOutProperties(2, {"Q"});
    for (std::size_t below = 2; below < draft.GetClasses()[2].treeEnd; ++below) {
        draft.LeaveOutProperties(below, {"q"});
    }
    draft.Remark(2, "q grows");
    EXPECT_EQ("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
              "<!-- Two\n     lines -->\n"
              "<DifftoolSpec version=\"1.0\">\n"
              "  <class name=\"&lt;root&gt;\" default=\"include\"/>\n"
              "  <!-- q grows -->\n"
              "  <class name=\"B\" default=\"include\">\n"
              "    <excludelist>\n"
              "      <value>q</value>\n"
              "    </excludelist>\n"
              "  </class>\n"
              "</DifftoolSpec>\n",
              draft.Write({"Two", "lines"}));
}

TEST_F(RulesDraftTest, ComparesWhetherInstancesAreThereIfNoOtherPropertyIsLeft)
{
    TRulesDraft draft =
        MakeDraft("<DifftoolSpec><class name=\"B\"><includelist><value>q</value></includelist></class></DifftoolSpec>");
    draft.LeaveOutProperties(2, {"q"});
    EXPECT_EQ("B: k1\n", Line("B", draft.GetClasses()[2].compared, {}));
}

TEST_F(RulesDraftTest, LeavesTheClassOutIfNoKeyIsLeftEither)
{
    TRulesDraft draft =
        MakeDraft("<DifftoolSpec><class name=\"B\"><includelist><value>q</value></includelist></class></DifftoolSpec>");
    draft.LeaveOutProperties(2, {"q", "k1", "k2"});
    EXPECT_EQ("B:\n", Line("B", draft.GetClasses()[2].compared, {}));
}

}  // namespace
}  // namespace NORVZEL20
