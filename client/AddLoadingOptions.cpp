#include "client/AddLoadingOptions.h"

#include <algorithm>
#include <functional>
#include <string>
#include <vector>

#include "client/AddText.h"
#include "client/ArgumentGuard.h"
#include "client/text/Alternatives.h"

namespace NORVZEL20 {

namespace {

void AddBadValues(CLI::App* command, EBadValues& choice)
{
    const std::function<void(const std::string&)> set = [&choice](const std::string& name) {
        const std::vector<std::string> names{"refuse", "null", "text"};  // in the order of EBadValues
        const auto found = std::find(names.begin(), names.end(), name);
        if (found == names.end()) {
            throw CLI::ValidationError("--bad-values " + name + " is no choice; name one: " + Alternatives(names));
        }
        choice = static_cast<EBadValues>(found - names.begin());
    };
    command
        ->add_option_function(
            "--bad-values", set,
            "what becomes of values that do not fit their types: refuse the inventory (the default), take them as\n"
            "null, or keep and compare them as text")
        ->transform(&UnguardArgument)
        ->check(&RefuseEmpty)
        ->option_text("CHOICE");
}

}  // namespace

void AddLoadingOptions(CLI::App* command, TLoadingOptions& loading, const std::string& schemaNames)
{
    loading.schemaOption = schemaNames.substr(0, schemaNames.find(','));
    AddText(command, schemaNames.c_str(), loading.schemas,
            "files or folders whose declarations serve for all inventories that lack them; the option may be repeated")
        ->allow_extra_args(false)
        ->option_text("SOURCE[,SOURCE...]");
    command->add_flag(
        "--infer-classes", loading.infersClasses,
        "declare classes that nothing declares as their instances suggest: keys by their names, types by their values");
    AddText(
        command, "--namespace", loading.namespaces,
        "the namespace of inventories that name none, not even in references (default: root/cimv2); LABEL= in front makes it that "
        "of one inventory")
        // Otherwise the option would also take the arguments behind its value.
        ->allow_extra_args(false)
        ->option_text("[LABEL=]NAME");
    AddBadValues(command, loading.badValues);
}

}  // namespace NORVZEL20
