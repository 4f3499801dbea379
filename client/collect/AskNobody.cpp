// Takes the place of AskServiceManager.cpp if the library for D-Bus (libsystemd) is not there.
#include "client/collect/AskServiceManager.h"

namespace NORVZEL20 {

std::optional<std::vector<TUnitState>> AskServiceManager(const std::string& /*address*/, std::string& trouble)
{
    trouble = "this cimdelta was built without libsystemd";
    return std::nullopt;
}

}  // namespace NORVZEL20
