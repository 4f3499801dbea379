#pragma once

#include <cstdint>
#include <ostream>
#include <string>

namespace NORVZEL20 {

/// Writes CIM-XML inventories of one class, BENCH_Software, with 13 properties: texts of 8 to 48 characters, numbers, a boolean, a
/// datetime and a real.
///
/// The same arguments give the same bytes on every machine. The second state of an inventory differs from the first in 1 % of the
/// values that are no keys, lacks 0.5 % of the instances and has 0.5 % new ones.
class TInventoryGenerator {
  public:
    explicit TInventoryGenerator(unsigned int instances, std::uint64_t seed = 1) : fInstances(instances), fSeed(seed) {}

    void WriteFirstState(std::ostream& out) const { Write(out, false); }
    void WriteSecondState(std::ostream& out) const { Write(out, true); }

  private:
    void Write(std::ostream& out, bool second) const;
    void AppendInstance(std::string& xml, std::uint64_t number, bool second) const;
    std::uint64_t Random(std::uint64_t number, unsigned int property, bool second) const;

    unsigned int fInstances;
    std::uint64_t fSeed;
};

}  // namespace NORVZEL20
