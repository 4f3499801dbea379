#pragma once

#include <string>

namespace NORVZEL20 {

/// How many instances each inventory of the benchmarks has.
constexpr unsigned int kBenchInstances = 100000;

/// The two states of the generated inventory, made on first use and kept in memory.
const std::string& FirstState();
const std::string& SecondState();

/// A comparison specification, in a file that is removed at exit, which includes every property of the generated class.
const std::string& RulesFile();

}  // namespace NORVZEL20
