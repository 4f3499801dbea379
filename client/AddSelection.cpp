#include "client/AddSelection.h"

#include <boost/algorithm/string/classification.hpp>
#include <boost/algorithm/string/split.hpp>

#include "client/AddText.h"

namespace NORVZEL20 {

namespace {

void AddNames(CLI::App* command, const char* name, std::vector<std::string>& names, const char* form, const char* description)
{
    AddText(command, name, names, description)->allow_extra_args(false)->option_text(form);
}

TDifference::EKind KindOf(const std::string& name, const std::string& all)
{
    if (name == "-" || name == "missing") {
        return TDifference::kOnlyInReference;
    }
    if (name == "+" || name == "added") {
        return TDifference::kOnlyInOthers;
    }
    if (name == "~" || name == "changed") {
        return TDifference::kChanged;
    }
    throw CLI::ValidationError("--only " + all + " is no list of kinds; name some of +, - and ~, or added, missing and changed" +
                               (name.find('/') != std::string::npos ? " (the shell replaces a ~ that stands alone)" : ""));
}

void AddOnly(CLI::App* command, TOnlyShown& only)
{
    const std::function<void(const std::string&)> set = [&only](const std::string& text) {
        std::vector<std::string> names;
        boost::algorithm::split(names, text, boost::algorithm::is_any_of(","));
        for (const std::string& name : names) {
            only.kinds.insert(KindOf(name, text));
        }
        only.option = "--only " + text;
    };
    command
        ->add_option_function("--only", set,
                              "show only these kinds of differences: + or added, - or missing, ~ or changed; the exit\n"
                              "status counts what is shown")
        ->transform(&TakeGuardOff)
        ->check(&RefuseEmpty)
        ->option_text("KIND[,KIND...]");
}

}  // namespace

void AddSelection(CLI::App* command, TCompareOptions& options)
{
    TSelection& selection = options.selection;
    AddNames(command, "--class", selection.classes, "CLASS",
             "compare only this class and the classes below it; names may have the wildcards * and ?, in any letter case; repeat "
             "the option for several");
    AddNames(command, "--property", selection.properties, "[CLASS.]NAME", "compare only this property, likewise");
    AddNames(command, "--exclude", selection.excluded, "CLASS[.NAME]",
             "leave out this class with those below it, or this property, likewise");
    AddNames(command, "--exclude-key", selection.excludedKeys, "[CLASS.]KEY",
             "match instances without this key, and do not compare it, likewise");
    AddOnly(command, options.only);
    AddSaveRules(command, options.savedRules);
}

void AddSaveRules(CLI::App* command, std::string& path)
{
    AddText(command, "--save-rules", path, "write the rules to this file, whole or not at all")->option_text("FILE");
}

}  // namespace NORVZEL20
