// A class hands its rules down to the classes below it, and an element that follows merges into what has come from above. So the
// classes are visited from top to bottom, and a class gets an element only if it is to have something else than it has by then:
//
//   <class name="Element" default="include"/>         everything of Element and of the classes below it
//   <class name="Package" default="include">          but not the date of Package
//     <excludelist> <value>InstalledOn</value> ...
//
// Excluded keys are different: a class keeps those of the first rules that reach it. If they are not those of the class above,
// the class needs an element in front of all those of the classes above it. Such elements come first, from bottom to top, and have
// nothing but the keys; default and lists follow in the second pass.
#include "client/rules/WriteRules.h"

#include <algorithm>
#include <boost/algorithm/string/join.hpp>
#include <boost/algorithm/string/replace.hpp>
#include <map>
#include <set>

#include "client/rules/RulesXml.h"
#include "client/text/DisplayText.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

using TClass = TRulesDraft::TClass;

// A comment must not hold two dashes in a row, nor end with one.
std::string CommentText(const std::string& text)
{
    std::string shown = EscapeForDisplay(text);
    while (shown.find("--") != std::string::npos) {
        boost::algorithm::replace_all(shown, "--", "- -");
    }
    return shown;
}

std::string Comment(const std::vector<std::string>& lines, const std::string& indentation)
{
    std::vector<std::string> texts;
    for (const std::string& line : lines) {
        texts.push_back(CommentText(line));
    }
    return texts.empty() ? std::string()
                         : indentation + "<!-- " + boost::algorithm::join(texts, "\n" + indentation + "     ") + " -->\n";
}

// What the rules written so far give a class.
struct TGiven {
    bool isReached = false;
    bool isByDefault = false;
    std::map<std::string, bool> listed;  // whether each property in a list is compared
};

class TRulesWriter {
  public:
    explicit TRulesWriter(const std::vector<TClass>& classes) : fClasses(classes), fPlans(classes.size()) {}

    std::string Write()
    {
        for (std::size_t position = 0; position < fClasses.size(); ++position) {
            Plan(position);
        }
        std::string text;
        for (std::size_t position = fClasses.size(); position > 0; --position) {
            text += WriteKeys(position - 1);
        }
        for (std::size_t position = 0; position < fClasses.size(); ++position) {
            text += WriteElement(position);
        }
        return text;
    }

  private:
    // What becomes of a class.
    struct TPlan {
        TGiven given;  // behind its element
        std::vector<std::string> keys;
        bool hasElement = false;
        bool isFirst = false;  // no element reaches it before its own
        std::vector<std::string> included;
        std::vector<std::string> excluded;
    };

    void Plan(std::size_t position)
    {
        const TClass& cls = fClasses[position];
        TPlan& plan = fPlans[position];
        if (position > 0) {
            plan.given = fPlans[cls.parent].given;
            plan.keys = fPlans[cls.parent].keys;
        }
        if (cls.isByDefault || !cls.compared.empty()) {
            plan.keys = cls.excludedKeys;
        }
        plan.hasElement = plan.given.isReached ? cls.isByDefault != plan.given.isByDefault || !IsAsGiven(cls, plan.given)
                                               : cls.isByDefault || !cls.compared.empty();
        if (plan.hasElement) {
            plan.isFirst = !plan.given.isReached;
            plan.given.isReached = true;
            plan.given.isByDefault = cls.isByDefault;
            ListProperties(cls, plan);
        }
    }

    static void ListProperties(const TClass& cls, TPlan& plan)
    {
        for (const std::string& name : NamesOf(cls, plan.given)) {
            const bool isCompared = cls.compared.count(name) > 0;
            if (isCompared != IsGiven(cls, plan.given, name)) {
                plan.given.listed[name] = isCompared;
                (isCompared ? plan.included : plan.excluded).push_back(name);
            }
        }
    }

    // The properties that the class or a list names.
    static std::set<std::string> NamesOf(const TClass& cls, const TGiven& given)
    {
        std::set<std::string> names = cls.compared;
        names.insert(cls.declared.begin(), cls.declared.end());
        for (const auto& entry : given.listed) {
            names.insert(entry.first);
        }
        return names;
    }

    static bool IsAsGiven(const TClass& cls, const TGiven& given)
    {
        const std::set<std::string> names = NamesOf(cls, given);
        return std::all_of(names.begin(), names.end(),
                           [&](const std::string& name) { return IsGiven(cls, given, name) == (cls.compared.count(name) > 0); });
    }

    static bool IsGiven(const TClass& cls, const TGiven& given, const std::string& name)
    {
        const auto listed = given.listed.find(name);
        if (listed != given.listed.end()) {
            return listed->second;
        }
        return given.isByDefault && name != kCollectionTime && std::count(cls.declared.begin(), cls.declared.end(), name) > 0;
    }

    // Whether the class needs an element for its keys alone.
    bool HasElementForKeys(std::size_t position) const
    {
        const TPlan& plan = fPlans[position];
        return position > 0 && plan.given.isReached && !plan.isFirst && plan.keys != fPlans[fClasses[position].parent].keys;
    }

    std::string WriteKeys(std::size_t position) const
    {
        return HasElementForKeys(position)
                   ? WriteRulesElement({fClasses[position].name, std::string(), fPlans[position].keys, {}, {}})
                   : std::string();
    }

    std::string WriteElement(std::size_t position) const
    {
        const TClass& cls = fClasses[position];
        const TPlan& plan = fPlans[position];
        const std::string remarks = Comment(cls.remarks, "  ");
        if (!plan.hasElement) {
            return remarks;
        }
        const std::vector<std::string> keys = plan.isFirst ? plan.keys : std::vector<std::string>();
        return remarks + WriteRulesElement({cls.name, cls.isByDefault ? "include" : "exclude", keys, plan.included, plan.excluded});
    }

    const std::vector<TClass>& fClasses;
    std::vector<TPlan> fPlans;
};

}  // namespace

std::string WriteRules(const std::vector<TRulesDraft::TClass>& classes, const std::vector<std::string>& heading)
{
    return kRulesDeclaration + Comment(heading, "") + WriteRulesDocument(TRulesWriter(classes).Write());
}

}  // namespace NORVZEL20
