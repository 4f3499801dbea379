#pragma once

#include <cstddef>
#include <map>
#include <string>

#include "client/inventory/TInventory.h"

namespace NORVZEL20 {

/// The order in which the classes of an inventory have their properties. It knows the class that was asked for last, so ask for one
/// class after the other. Threads: one at a time.
class TPropertyOrder {
  public:
    /// The inventory must outlive this.
    explicit TPropertyOrder(const TInventory& inventory) : fInventory(inventory) {}

    /// The positions of the properties in the class, by the names that the class gives them; empty if it is not declared.
    /// Valid until another class is asked for. Errors: those of the host.
    const std::map<std::string, std::size_t>& Of(const std::string& className);

  private:
    const TInventory& fInventory;
    std::string fClassName;
    std::map<std::string, std::size_t> fOrder;
};

}  // namespace NORVZEL20
