#pragma once

#include <cstdint>
#include <ostream>
#include <string>
#include <vector>

namespace NORVZEL20 {

/// What a generated inventory is like.
struct TInventoryShape {
    unsigned int instances = 0;
    unsigned int classes = 1;           ///< at least 1; each has an equal share of the instances
    unsigned int changedPerMille = 10;  ///< how many of the values that are no keys change from state 0 to another state
    std::uint64_t shuffleSeed = 0;      ///< 0: in the order of classes and keys; otherwise in an order that depends on the seed
};

/// Writes CIM-XML inventories of classes with 13 properties, of which two are keys: texts of 8 to 60 characters, numbers, a
/// boolean, a datetime and a real. The class is BENCH_Software, or, if there are several, BENCH_Software000 and so on.
///
/// The same arguments give the same bytes on every machine. Any other state differs from state 0 in some of the values that are no
/// keys, lacks 0.5 % of the instances and has 0.5 % new ones.
class TInventoryGenerator {
  public:
    explicit TInventoryGenerator(const TInventoryShape& shape) : fShape(shape) {}

    void Write(std::ostream& out, unsigned int state) const;

  private:
    std::vector<std::uint64_t> Order() const;
    void AppendInstance(std::string& xml, std::uint64_t number, unsigned int state, bool isNew) const;
    std::string ClassOf(std::uint64_t number) const;
    std::uint64_t Random(std::uint64_t number, unsigned int property, unsigned int state) const;

    TInventoryShape fShape;
};

}  // namespace NORVZEL20
