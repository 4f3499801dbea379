#pragma once

#include <string>

namespace NORVZEL20 {

/// The path of the rules that a person names: `name` itself, or, if it is a word and no file of that name is there, rules that
/// come with the program: `linux` is data/rules/linux.xml below the host's root. Errors: std::bad_alloc.
std::string FindRules(const std::string& name);

/// Where FindRules found no rules that come with the program: ", and the program has no rules /PATH"; empty if the name is no word.
std::string WhyNoRules(const std::string& name);

}  // namespace NORVZEL20
