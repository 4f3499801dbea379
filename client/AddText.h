#pragma once

#include <CLI/CLI.hpp>
#include <string>

#include "client/ArgumentGuard.h"

namespace NORVZEL20 {

/// What is wrong with a text that is empty; empty if it is not.
inline std::string RefuseEmpty(const std::string& text)
{
    return text.empty() ? "must not be empty" : "";
}

/// Adds an option or an argument whose values are texts as they were typed, and not empty.
template <class TTarget>
CLI::Option* AddText(CLI::App* command, const char* name, TTarget& target, const char* description)
{
    return command->add_option(name, target, description)->transform(&TakeGuardOff)->check(&RefuseEmpty);
}

}  // namespace NORVZEL20
