#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <string>

#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// The arguments of `cimdelta collect --from`.
struct TCollectFromOptions {
    std::string server;  ///< the address
    std::string namespaceName = "root/cimv2";
    bool takesAllNamespaces = false;  ///< `output` is then a folder, which gets a file for each
    std::string output;               ///< empty: standard output
    bool hasNetrc = false;
    std::string netrcFile;  ///< empty: ~/.netrc
    std::string caFile;     ///< empty: the authorities of the system
    bool mayPassInTheOpen = false;
    std::chrono::seconds silence{120};
    std::chrono::seconds timeLimit{3600};
    std::uint64_t sizeLimit = 4096;  ///< MiB
    std::size_t instanceLimit = 10000000;
};

/// Writes what a WBEM server has in a namespace, or in each of its namespaces, as inventories. Each file is written whole or not at
/// all. What could not be collected is said on standard error and named in the inventory.
/// Returns kExitSuccess (0), or kExitTrouble (2) if a namespace of several could not be collected. Errors: TClientError.
int RunCollectFrom(const TCollectFromOptions& options, IConsole& console);

/// The name of the file for a namespace: "root-cimv2.xml" for root/cimv2. Bytes other than letters, digits, "_" and "." are
/// percent-encoded, "-" too, so different namespaces have different files.
std::string FileNameOfNamespace(const std::string& namespaceName);

}  // namespace NORVZEL20
