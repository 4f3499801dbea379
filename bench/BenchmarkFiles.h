#pragma once

#include <string>

namespace NORVZEL20 {

/// The number of instances in each inventory of the benchmarks.
constexpr unsigned int kBenchInstances = 100000;

/// Two states of the generated inventory of one class as CIM-XML, made on first use and kept in memory.
const std::string& FirstState();
const std::string& SecondState();

/// The path of a specification file that includes every property of the generated class. The file is removed at exit.
const std::string& RulesFile();

}  // namespace NORVZEL20
