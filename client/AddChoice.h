#pragma once

#include <algorithm>
#include <functional>
#include <string>
#include <vector>

#include "client/AddText.h"
#include "client/ArgumentGuard.h"
#include "client/text/Alternatives.h"

namespace NORVZEL20 {

/// Adds an option that takes one of the names, which are those of the enumerators from 0 on, in their order.
template <class TEnum>
CLI::Option* AddChoice(CLI::App* command, const std::string& option, TEnum& choice, const std::vector<std::string>& names,
                       const char* description)
{
    const std::function<void(const std::string&)> set = [option, &choice, names](const std::string& name) {
        const auto found = std::find(names.begin(), names.end(), name);
        if (found == names.end()) {
            throw CLI::ValidationError(option + " " + name + " is no choice; name one: " + Alternatives(names));
        }
        choice = static_cast<TEnum>(found - names.begin());
    };
    return command->add_option_function(option, set, description)
        ->transform(&TakeGuardOff)
        ->check(&RefuseEmpty)
        ->option_text("CHOICE");
}

}  // namespace NORVZEL20
