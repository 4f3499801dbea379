#pragma once

#include <CLI/CLI.hpp>
#include <string>

namespace NORVZEL20 {

/// What is wrong with the arguments of `command`, which CLI11 refused with `error` while `app` parsed them. CLI11's own words stand
/// for the mistakes that are rare. Errors: std::bad_alloc.
std::string DescribeWrongUsage(const CLI::ParseError& error, const CLI::App& app, const CLI::App& command);

}  // namespace NORVZEL20
