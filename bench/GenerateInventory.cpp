// Writes one of the inventories of the benchmarks to standard output.

#include <cstdlib>
#include <iostream>
#include <string>

#include "bench/TInventoryGenerator.h"

int main(int argc, char** argv)
{
    if (argc != 3 || (std::string(argv[2]) != "first" && std::string(argv[2]) != "second")) {
        std::cerr << "usage: generate_inventory INSTANCES first|second > FILE\n";
        return 2;
    }
    const NORVZEL20::TInventoryGenerator generator(static_cast<unsigned int>(std::strtoul(argv[1], nullptr, 10)));
    if (std::string(argv[2]) == "first") {
        generator.WriteFirstState(std::cout);
    } else {
        generator.WriteSecondState(std::cout);
    }
    return std::cout.good() ? 0 : 2;
}
