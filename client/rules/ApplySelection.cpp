// Names are looked up in the classes of the draft, and what they name is changed there, class by class:
//
//   --class       leaves out all classes that no name stands for
//   --property    leaves out all properties that no name stands for, and so all classes without any of them
//   --exclude     leaves out classes, or properties
//   --exclude-key leaves a key out of what identifies instances
#include "client/rules/ApplySelection.h"

#include <algorithm>
#include <map>
#include <optional>

#include "client/process/TClientError.h"
#include "client/text/DisplayText.h"
#include "client/text/MatchesWildcards.h"
#include "client/text/NearestWord.h"
#include "client/text/QuoteForShell.h"

namespace NORVZEL20 {

namespace {

using TClass = TRulesDraft::TClass;

// A name as it was typed, with the option in front of it.
struct TTypedName {
    std::string option;
    std::optional<std::string> className;
    std::optional<std::string> member;  // a property or a key

    std::string Show() const
    {
        return option + " " + EscapeForDisplay(className.value_or("") + (className && member ? "." : "") + member.value_or(""));
    }
};

TTypedName Split(const std::string& option, const std::string& text, bool isMember)
{
    const std::size_t dot = text.find('.');
    if (dot == std::string::npos) {
        return isMember ? TTypedName{option, std::nullopt, text} : TTypedName{option, text, std::nullopt};
    }
    if (dot == 0 || dot + 1 == text.size()) {
        throw TClientError(option + " " + EscapeForDisplay(text) + ": has nothing on one side of the dot; write CLASS.NAME");
    }
    return {option, text.substr(0, dot), text.substr(dot + 1)};
}

// "; did you mean Package?", or nothing.
std::string Suggest(const std::string& typed, const std::set<std::string, TNameText::TLess>& names)
{
    std::map<std::string, std::string> spellings;
    std::vector<std::string> words;
    for (const std::string& name : names) {
        words.push_back(TNameText::ToLower(name));
        spellings[words.back()] = name;
    }
    std::string plain = TNameText::ToLower(typed);
    plain.erase(std::remove_if(plain.begin(), plain.end(), [](char c) { return c == '*' || c == '?'; }), plain.end());
    const std::string nearest = NearestWord(plain, words);
    return nearest.empty() ? std::string() : "; did you mean " + EscapeForDisplay(spellings[nearest]) + "?";
}

class TSelector {
  public:
    explicit TSelector(TRulesDraft& draft) : fDraft(draft), fBefore(draft.GetClasses()) {}

    void KeepClasses(const std::vector<std::string>& names)
    {
        std::set<std::size_t> kept;
        for (const std::string& name : names) {
            const TTypedName typed = Split("--class", name, false);
            if (typed.member) {
                throw TClientError(typed.Show() + ": is no class; name properties with --property");
            }
            kept.merge(FindTrees(typed));
        }
        for (std::size_t position = 0; !names.empty() && position < fBefore.size(); ++position) {
            if (kept.count(position) == 0) {
                fDraft.LeaveOut(position);
            }
        }
    }

    void KeepProperties(const std::vector<std::string>& names)
    {
        std::map<std::size_t, TRulesDraft::TNames> kept;
        for (const std::string& name : names) {
            const TTypedName typed = Split("--property", name, true);
            const auto found = FindMembers(typed, &TClass::declared, "property");
            RequireCompared(typed, found);
            for (const auto& [position, properties] : found) {
                kept[position].insert(properties.begin(), properties.end());
            }
        }
        for (std::size_t position = 0; !names.empty() && position < fBefore.size(); ++position) {
            fDraft.CompareOnly(position, kept[position]);
        }
    }

    void LeaveOut(const std::vector<std::string>& names)
    {
        std::map<std::size_t, TRulesDraft::TNames> excluded;
        for (const std::string& name : names) {
            const TTypedName typed = Split("--exclude", name, false);
            if (!typed.member) {
                for (const std::size_t position : FindTrees(typed)) {
                    fDraft.LeaveOut(position);
                }
                continue;
            }
            for (const auto& [position, properties] : FindMembers(typed, &TClass::declared, "property")) {
                excluded[position].insert(properties.begin(), properties.end());
            }
        }
        for (const auto& [position, properties] : excluded) {
            fDraft.LeaveOutProperties(position, properties);
        }
    }

    void ExcludeKeys(const std::vector<std::string>& names)
    {
        for (const std::string& name : names) {
            for (const auto& [position, keys] : FindMembers(Split("--exclude-key", name, true), &TClass::keys, "key")) {
                for (const std::string& key : keys) {
                    fDraft.ExcludeKey(position, key);
                }
            }
        }
    }

  private:
    using TMembers = std::map<std::size_t, TRulesDraft::TNames>;

    // The classes that the name stands for, and those below them. Without a class, all of them.
    std::set<std::size_t> FindTrees(const TTypedName& typed) const
    {
        std::set<std::size_t> found;
        const std::string pattern = typed.className.value_or("*");
        for (std::size_t position = 1; position < fBefore.size(); ++position) {
            if (MatchesWildcards(pattern, fBefore[position].name)) {
                for (std::size_t below = position; below < fBefore[position].treeEnd; ++below) {
                    found.insert(below);
                }
            }
        }
        if (found.empty()) {
            RefuseClass(typed);
        }
        return found;
    }

    [[noreturn]] void RefuseClass(const TTypedName& typed) const
    {
        std::set<std::string, TNameText::TLess> names;
        bool isProperty = false;
        for (std::size_t position = 1; position < fBefore.size(); ++position) {
            names.insert(fBefore[position].name);
            isProperty =
                isProperty ||
                std::any_of(fBefore[position].declared.begin(), fBefore[position].declared.end(), [&](const std::string& name) {
                    return !typed.member && typed.className && MatchesWildcards(*typed.className, name);
                });
        }
        const std::string name = typed.className.value_or("*");
        const std::string advice =
            isProperty ? "; for the property, write " + EscapeForDisplay(typed.option == "--class"
                                                                             ? "--property " + QuoteForShell(name)
                                                                             : typed.option + " " + QuoteForShell("*." + name))
                       : Suggest(name, names);
        throw TClientError(typed.Show() + ": the reference declares no such class" + advice);
    }

    TMembers FindMembers(const TTypedName& typed, const std::vector<std::string> TClass::*members, const std::string& kind) const
    {
        TMembers found;
        std::set<std::string, TNameText::TLess> others;
        bool isProperty = false;
        for (const std::size_t position : FindTrees(typed)) {
            for (const std::string& name : fBefore[position].*members) {
                if (MatchesWildcards(*typed.member, name)) {
                    found[position].insert(name);
                }
                others.insert(name);
            }
            isProperty = isProperty || std::any_of(fBefore[position].declared.begin(), fBefore[position].declared.end(),
                                                   [&](const std::string& name) { return MatchesWildcards(*typed.member, name); });
        }
        if (found.empty()) {
            const std::string of = typed.className ? "the classes that it names have" : "no class has";
            throw TClientError(
                typed.Show() + ": " + of + (typed.className ? " no such " : " such a ") + kind +
                (isProperty ? "; a property that is no key is left out with --exclude" : Suggest(*typed.member, others)));
        }
        return found;
    }

    void RequireCompared(const TTypedName& typed, const TMembers& members) const
    {
        for (const auto& [position, names] : members) {
            for (const std::string& name : fBefore[position].compared) {
                if (names.count(name) > 0) {
                    return;
                }
            }
        }
        const auto& [position, names] = *members.begin();
        throw TClientError(typed.Show() + ": is not compared without the option either; cimdelta explain " +
                           fBefore[position].name + "." + *names.begin() + " says why");
    }

    TRulesDraft& fDraft;
    const std::vector<TClass> fBefore;
};

}  // namespace

void ApplySelection(const TSelection& selection, TRulesDraft& draft)
{
    TSelector selector(draft);
    selector.KeepClasses(selection.classes);
    selector.ExcludeKeys(selection.excludedKeys);
    selector.KeepProperties(selection.properties);
    selector.LeaveOut(selection.excluded);
}

}  // namespace NORVZEL20
